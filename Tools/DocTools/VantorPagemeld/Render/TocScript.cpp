#include "Tools/DocTools/VantorPagemeld/Render/TocScript.h"

#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "Tools/DocTools/VantorPagemeld/Render/ModulePrefix.h"

#include <initializer_list>
#include <optional>
#include <string_view>

// The script is an object literal whose links are expressions, so no JSON writer can write it.

namespace
{

constexpr std::string_view kLinkOfGroup = "null";

/// Returns the node's module: its first "module" member that is a 32-bit integer. A member of another type
/// can come from an input file and is skipped.
std::optional<int> FindModule(const rapidjson::Value& node)
{
    for (const auto& member : node.GetObject())
    {
        if (BytesOf(member.name) == "module" && member.value.IsInt())
        {
            return member.value.GetInt();
        }
    }
    return std::nullopt;
}

/// Appends to a script in one layout.
class Writer
{
public:
    Writer(TextBuffer& script, const TocScriptLayout& layout) : m_script(script), m_layout(layout) {}

    void AppendToc(const rapidjson::Value& toc)
    {
        AppendText(m_script, "toc = {\n");
        AppendString("link", ": ", 1, false);
        AppendString(CStringOf(toc["link"]), ",", 0, m_layout.lineBreaks);
        AppendString("title", ": ", 1, false);
        AppendString(CStringOf(toc["title"]), ",", 0, m_layout.lineBreaks);
        // The root always shows a list, even for null; nodes below it show null as it is.
        AppendString("children", ": [", 1, m_layout.lineBreaks);
        if (const rapidjson::Value* children = FindMember(toc, "children"))
        {
            AppendValue(*children, 2);
        }
        AppendText(m_script, "]};\n");
    }

    void AppendValue(const rapidjson::Value& value, int indent)
    {
        if (value.IsObject())
        {
            AppendNode(value, indent);
        }
        else if (value.IsArray())
        {
            AppendList(value, indent);
        }
    }

    void AppendString(const char* text, const char* extra, int indent, bool newLine)
    {
        AppendIndent(indent);
        AppendTitleLiteral(m_script, text);
        Append({extra, newLine ? "\n" : ""});
    }

private:
    void AppendNode(const rapidjson::Value& node, int indent)
    {
        AppendNodeStart(node, indent);
        AppendChildren(node["children"], indent);
        AppendIndent(indent);
        Append({"}", m_lineBreak});
    }

    /// Appends a node up to its children. Never inlined: its many locals would enlarge the stack frame of the
    /// recursion, and a table of contents may be thousands of levels deep.
    [[gnu::noinline]] void AppendNodeStart(const rapidjson::Value& node, int indent)
    {
        AppendIndent(indent);
        Append({"{", m_lineBreak});
        AppendString("link", ": ", indent + 1, false);
        AppendLink(node);
        AppendString("title", ": ", indent + 1, false);
        AppendString(CStringOf(node["title"]), ",", 0, m_layout.lineBreaks);
        AppendString("children", ": ", indent + 1, false);
    }

    void AppendLink(const rapidjson::Value& node)
    {
        const char* const link = CStringOf(node["link"]);
        const std::optional<int> module = FindModule(node);
        if (!module)
        {
            AppendString(link, ",", 0, m_layout.lineBreaks);
            return;
        }
        if (link != kLinkOfGroup)
        {
            // The browser joins the two texts, so that the body is the same for all modules.
            Append({PrefixVariable(*module), "+"});
        }
        AppendPathLiteral(m_script, link);
        Append({",", m_lineBreak});
    }

    void AppendChildren(const rapidjson::Value& children, int indent)
    {
        if (children.IsNull())
        {
            AppendText(m_script, "null");
        }
        else
        {
            Append({"[", m_lineBreak});
            AppendValue(children, indent + 2); // nothing between the brackets if it is neither list nor node
            AppendIndent(indent + 1);
            AppendText(m_script, "]");
        }
        AppendText(m_script, m_lineBreak);
    }

    void AppendList(const rapidjson::Value& list, int indent)
    {
        for (rapidjson::SizeType i = 0; i < list.Size(); ++i)
        {
            AppendValue(list[i], indent + 2);
            if (i + 1 < list.Size())
            {
                // With line breaks, each node has ended its line: the comma gets one of its own.
                AppendIndent(indent + 2);
                Append({",", m_lineBreak});
            }
        }
    }

    void AppendIndent(int indent)
    {
        for (int i = 0; m_layout.indentation && i < indent; ++i)
        {
            AppendText(m_script, " ");
        }
    }

    void Append(std::initializer_list<std::string_view> texts)
    {
        for (const std::string_view text : texts)
        {
            AppendText(m_script, text);
        }
    }

    TextBuffer& m_script;
    const TocScriptLayout& m_layout;
    const std::string_view m_lineBreak = m_layout.lineBreaks ? "\n" : "";
};

} // namespace

TextBuffer RenderTocScript(const rapidjson::Value& toc, const TocScriptLayout& layout)
{
    TextBuffer script;
    Writer(script, layout).AppendToc(toc);
    return script;
}

void AppendTocValue(TextBuffer& script, const rapidjson::Value& value, int indent,
                    const TocScriptLayout& layout)
{
    Writer(script, layout).AppendValue(value, indent);
}

void AppendTocString(TextBuffer& script, const char* text, const char* extra, int indent, bool newLine,
                     const TocScriptLayout& layout)
{
    Writer(script, layout).AppendString(text, extra, indent, newLine);
}
