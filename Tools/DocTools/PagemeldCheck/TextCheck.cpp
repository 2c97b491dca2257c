#include "Tools/DocTools/PagemeldCheck/TextCheck.h"

#include "Tools/DocTools/PagemeldCheck/Browse/ScriptLiteral.h"
#include "Tools/DocTools/PagemeldCheck/Browse/WebPath.h"
#include "Tools/DocTools/PagemeldCheck/ByteSet.h"
#include "Tools/DocTools/PagemeldCheck/TargetCheck.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "Tools/DocTools/VantorPagemeld/Render/TextBuffer.h"

namespace
{

using rapidjson::Value;

/// How the scripts hold a text.
enum class TextKind
{
    Title,
    Path,
};

/// Looks at the texts of one file.
class TextCheck
{
public:
    TextCheck(Output script, FileFindings& findings)
        : m_script(RowOf(kOutputs, script).name), m_findings(findings), m_targets(findings)
    {
    }

    TargetCheck& Targets() { return m_targets; }

    /// Returns what the script has for the text, if that is another one. pagePath is that of the page whose
    /// title this is; null for other texts.
    std::optional<std::string> CheckText(TextKind kind, const char* name, const Value& text,
                                         const JsonPointer& pointer, const Value* pagePath = nullptr)
    {
        if (!NeedsLook(kind, BytesOf(text)))
        {
            return std::nullopt;
        }
        std::optional<std::string> value = ValueOfScriptLiteral(LiteralOf(kind, text));
        const auto named = [&]
        {
            return std::string(name) + " " + m_findings.Quote(BytesOf(text)) +
                   (pagePath == nullptr ? "" : " of page " + m_findings.Quote(BytesOf(*pagePath)));
        };
        if (!value)
        {
            m_findings.AddAtValue(Rule::ScriptBroken, text, pointer,
                                  [&] { return named() + " breaks " + m_script + " in every module"; });
        }
        else if (*value != BytesOf(text))
        {
            m_findings.AddAtValue(Rule::ScriptAltered, text, pointer,
                                  [&]
                                  {
                                      return named() + " is " + m_findings.Quote(*value) + " in " + m_script +
                                             (kind == TextKind::Title ? ": readers see that"
                                                                      : ": readers are led there");
                                  });
        }
        return value;
    }

    /// A page path, or a link below the root, which the scripts put a prefix before.
    void CheckLink(const char* name, const Value& link, const JsonPointer& pointer)
    {
        const std::optional<std::string> other = CheckText(TextKind::Path, name, link, pointer);
        const std::string_view path = other ? *other : BytesOf(link);
        const bool isAddress = IsAddress(path);
        if (isAddress || (!m_findings.Scope().options.checksTargets && IsDoubtful(path)))
        {
            m_findings.AddAtValue(Rule::PrefixedUrl, link, pointer,
                                  [&]
                                  {
                                      return std::string(name) + " " + m_findings.Quote(BytesOf(link)) +
                                             " gets the module's prefix, and is dead " +
                                             (isAddress
                                                  ? "without the page script"
                                                  : "unless a file has that name, which --targets checks");
                                  });
        }
        else
        {
            m_targets.Check(name, link, pointer, path);
        }
    }

private:
    /// Whether a path may be the address of something outside. "std::list.html" is a file.
    static bool IsDoubtful(std::string_view path)
    {
        return HasScheme(path) && path.substr(path.find(':'), 2) != "::";
    }

    /// Cheap pre-check, false for nearly all texts.
    static bool NeedsLook(TextKind kind, std::string_view text)
    {
        static constexpr ByteSet kInTitles(std::string_view("\\\n\r\0", 4));
        static constexpr ByteSet kInPaths(std::string_view("\\\n\r\0\"", 5));
        return (kind == TextKind::Title ? kInTitles : kInPaths).HasAnyOf(text);
    }

    static std::string LiteralOf(TextKind kind, const Value& text)
    {
        TextBuffer literal;
        (kind == TextKind::Title ? AppendTitleLiteral : AppendPathLiteral)(literal, CStringOf(text));
        return std::string(TextOf(literal));
    }

    const char* m_script;
    FileFindings& m_findings;
    TargetCheck m_targets;
};

/// Never inlined: its many locals would enlarge the stack frame of the recursion, and a table of contents may
/// be thousands of levels deep.
[[gnu::noinline]] void CheckNode(TextCheck& check, const Value& node, const JsonPointer& pointer)
{
    const Value& link = *FindMember(node, "link");
    check.CheckText(TextKind::Title, "title", *FindMember(node, "title"), {pointer, "title"});
    if (std::string_view(CStringOf(link)) != "null")
    {
        check.CheckLink("link", link, {pointer, "link"});
    }
    else
    {
        check.CheckText(TextKind::Path, "link", link, {pointer, "link"}); // a NUL cuts "null\0x" to "null"
    }
}

/// Looks at all entries below a node.
void CheckChildren(TextCheck& check, const Value& node, const JsonPointer& pointer)
{
    const Value& children = *FindMember(node, "children");
    const JsonPointer list(pointer, "children");
    for (rapidjson::SizeType i = 0; children.IsArray() && i < children.Size(); ++i)
    {
        const JsonPointer child(list, i);
        CheckNode(check, children[i], child);
        CheckChildren(check, children[i], child);
    }
}

} // namespace

void CheckIndexTexts(const Value& index, FileFindings& findings)
{
    TextCheck check(Output::IndexScript, findings);
    const JsonPointer root;
    const JsonPointer pagesPointer(root, "pages");
    const Value& pages = *FindMember(index, "pages");
    for (rapidjson::SizeType i = 0; i < pages.Size(); ++i)
    {
        const JsonPointer page(pagesPointer, i);
        const Value& path = pages[i][0];
        check.CheckLink("page path", path, {page, 0U});
        check.CheckText(TextKind::Title, "title", pages[i][1], {page, 1U}, &path);
    }
    check.Targets().ReportUnreached();
}

void CheckTocTexts(const Value& toc, FileFindings& findings)
{
    TextCheck check(Output::TocScript, findings);
    const JsonPointer root;
    const Value& link = *FindMember(toc, "link");
    // The root's link is escaped as a title is, and gets no prefix.
    check.CheckText(TextKind::Title, "title", *FindMember(toc, "title"), {root, "title"});
    const std::optional<std::string> other = check.CheckText(TextKind::Title, "link", link, {root, "link"});
    const std::string_view path = other ? *other : BytesOf(link);
    if (path != "null" && !IsAddress(path))
    {
        check.Targets().Check("link", link, {root, "link"}, path);
    }
    CheckChildren(check, toc, root);
}
