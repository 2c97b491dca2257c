#include "Tools/DocTools/PagemeldCheck/TextCheck.h"

#include "Tools/DocTools/PagemeldCheck/Browse/ScriptLiteral.h"
#include "Tools/DocTools/PagemeldCheck/Browse/WebPath.h"
#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "Tools/DocTools/VantorPagemeld/Render/TextBuffer.h"
#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

namespace
{

using rapidjson::Value;

/// How the scripts hold a text.
enum class TextKind
{
    Title,
    Path,
};

bool IsFile(const std::string& path)
{
    const FileStatus status = FileStatus::Of(path);
    return status.Exists() && !status.IsDirectory();
}

/// Whether a link leads to a file below the directory, without what begins with "#" or "?": as it is, or
/// percent-decoded.
bool LeadsToFile(const std::string& directory, const std::string& link)
{
    const std::string path = link.substr(0, link.find_first_of("#?"));
    return IsFile(directory + "/" + path) || IsFile(directory + "/" + PercentDecoded(path));
}

/// Whether the link is an absolute URL. "std::list.html" is a file.
bool IsAddress(std::string_view link)
{
    return HasScheme(link) && link.substr(link.find(':'), 2) != "::";
}

/// Looks at the texts of one file.
class TextCheck
{
public:
    TextCheck(Output script, const FileScope& scope, FileFindings& findings)
        : m_script(RowOf(kOutputs, script).name), m_scope(scope), m_findings(findings)
    {
    }

    /// pagePath is that of the page whose title this is; null for other texts.
    void CheckText(TextKind kind, const char* name, const Value& text, const JsonPointer& pointer,
                   const Value* pagePath = nullptr)
    {
        if (!NeedsLook(kind, BytesOf(text)))
        {
            return;
        }
        const std::optional<std::string> value = ValueOfScriptLiteral(LiteralOf(kind, text));
        const auto named = [&]
        {
            return std::string(name) + " " + Quote(BytesOf(text)) +
                   (pagePath == nullptr ? "" : " of page " + Quote(BytesOf(*pagePath)));
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
                                      return named() + " is " + Quote(*value) + " in " + m_script +
                                             (kind == TextKind::Title ? ": readers see that"
                                                                      : ": the link is dead");
                                  });
        }
    }

    /// A page path, or a link below the root, which the scripts put a prefix before.
    void CheckLink(const char* name, const Value& link, const JsonPointer& pointer)
    {
        CheckText(TextKind::Path, name, link, pointer);
        if (IsAddress(BytesOf(link)))
        {
            m_findings.AddAtValue(Rule::PrefixedUrl, link, pointer,
                                  [&]
                                  {
                                      return std::string(name) + " " + Quote(BytesOf(link)) +
                                             " gets the module's prefix, and is dead without the page script";
                                  });
        }
        else
        {
            CheckTarget(name, link, pointer);
        }
    }

    void CheckTarget(const char* name, const Value& link, const JsonPointer& pointer)
    {
        if (m_scope.options.checksTargets && !IsAddress(BytesOf(link)) &&
            !LeadsToFile(m_scope.directory.Text(), CStringOf(link)))
        {
            m_findings.AddAtValue(Rule::MissingTarget, link, pointer,
                                  [&] {
                                      return std::string(name) + " " + Quote(BytesOf(link)) +
                                             " leads to no file: the link is dead";
                                  });
        }
    }

    void CheckNames(const Value& object, const char* kind, const JsonPointer& pointer)
    {
        for (const auto& member : object.GetObject())
        {
            if (BytesOf(member.name) == "__proto__")
            {
                m_findings.AddAtValue(
                    Rule::SpecialTerm, member.value, {pointer, BytesOf(member.name)},
                    [&] {
                        return std::string(kind) +
                               " \"__proto__\" sets a prototype in the scripts: readers do not find it";
                    });
            }
        }
    }

    [[nodiscard]] std::string Quote(std::string_view text) const
    {
        return Quoted(text, m_scope.options.quoteSize);
    }

private:
    /// Cheap pre-check, false for nearly all texts.
    static bool NeedsLook(TextKind kind, std::string_view text)
    {
        constexpr std::string_view kSpecial("\\\n\r\0\"", 5);
        return text.find_first_of(kSpecial.substr(0, kind == TextKind::Title ? 4 : 5)) !=
               std::string_view::npos;
    }

    static std::string LiteralOf(TextKind kind, const Value& text)
    {
        TextBuffer literal;
        (kind == TextKind::Title ? AppendTitleLiteral : AppendPathLiteral)(literal, CStringOf(text));
        return std::string(TextOf(literal));
    }

    const char* m_script;
    const FileScope& m_scope;
    FileFindings& m_findings;
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

void CheckIndexTexts(const Value& index, const FileScope& scope, FileFindings& findings)
{
    TextCheck check(Output::IndexScript, scope, findings);
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
    check.CheckNames(*FindMember(index, "common"), "common word", {root, "common"});
    check.CheckNames(*FindMember(index, "searchIndex"), "term", {root, "searchIndex"});
}

void CheckTocTexts(const Value& toc, const FileScope& scope, FileFindings& findings)
{
    TextCheck check(Output::TocScript, scope, findings);
    const JsonPointer root;
    const Value& link = *FindMember(toc, "link");
    // The root's link is escaped as a title is, and gets no prefix.
    check.CheckText(TextKind::Title, "title", *FindMember(toc, "title"), {root, "title"});
    check.CheckText(TextKind::Title, "link", link, {root, "link"});
    if (std::string_view(CStringOf(link)) != "null")
    {
        check.CheckTarget("link", link, {root, "link"});
    }
    CheckChildren(check, toc, root);
}
