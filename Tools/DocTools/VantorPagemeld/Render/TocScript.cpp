#include "Tools/DocTools/VantorPagemeld/Render/TocScript.h"

#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "Tools/DocTools/VantorPagemeld/Render/ModulePrefix.h"

#include <optional>
#include <string_view>

namespace
{

constexpr std::string_view kLinkOfGroup = "null";

void AppendIndent(TextBuffer& script, int indent, const TocScriptLayout& layout)
{
    for (int i = 0; layout.indentation && i < indent; ++i)
    {
        AppendText(script, " ");
    }
}

void AppendLineBreak(TextBuffer& script, const TocScriptLayout& layout)
{
    if (layout.lineBreaks)
    {
        AppendText(script, "\n");
    }
}

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

void AppendLink(TextBuffer& script, const rapidjson::Value& node, const TocScriptLayout& layout)
{
    const char* link = CStringOf(node["link"]);
    const std::optional<int> module = FindModule(node);
    if (!module)
    {
        AppendTocString(script, link, ",", 0, layout.lineBreaks, layout);
        return;
    }
    if (link != kLinkOfGroup)
    {
        AppendPrefixVariable(script, *module);
        AppendText(script, "+");
    }
    AppendPathLiteral(script, link);
    AppendText(script, ",");
    AppendLineBreak(script, layout);
}

void AppendChildren(TextBuffer& script, const rapidjson::Value& children, int indent,
                    const TocScriptLayout& layout)
{
    if (children.IsNull())
    {
        AppendText(script, "null");
    }
    else
    {
        AppendText(script, "[");
        AppendLineBreak(script, layout);
        AppendTocValue(script, children, indent + 2, layout);
        AppendIndent(script, indent + 1, layout);
        AppendText(script, "]");
    }
    AppendLineBreak(script, layout);
}

/// Appends a node up to its children. Never inlined: its many locals would enlarge the stack frame of the
/// recursion, and a table of contents may be thousands of levels deep.
[[gnu::noinline]] void AppendNodeStart(TextBuffer& script, const rapidjson::Value& node, int indent,
                                       const TocScriptLayout& layout)
{
    AppendIndent(script, indent, layout);
    AppendText(script, "{");
    AppendLineBreak(script, layout);
    AppendTocString(script, "link", ": ", indent + 1, false, layout);
    AppendLink(script, node, layout);
    AppendTocString(script, "title", ": ", indent + 1, false, layout);
    AppendTocString(script, CStringOf(node["title"]), ",", 0, layout.lineBreaks, layout);
    AppendTocString(script, "children", ": ", indent + 1, false, layout);
}

void AppendNode(TextBuffer& script, const rapidjson::Value& node, int indent, const TocScriptLayout& layout)
{
    AppendNodeStart(script, node, indent, layout);
    AppendChildren(script, node["children"], indent, layout);
    AppendIndent(script, indent, layout);
    AppendText(script, "}");
    AppendLineBreak(script, layout);
}

void AppendTocNodes(TextBuffer& script, const rapidjson::Value& list, int indent,
                    const TocScriptLayout& layout)
{
    for (rapidjson::SizeType i = 0; i < list.Size(); ++i)
    {
        AppendTocValue(script, list[i], indent + 2, layout);
        if (i + 1 < list.Size())
        {
            AppendIndent(script, indent + 2, layout);
            AppendText(script, ",");
            AppendLineBreak(script, layout);
        }
    }
}

} // namespace

TextBuffer RenderTocScript(const rapidjson::Value& toc, const TocScriptLayout& layout)
{
    TextBuffer script;
    AppendText(script, "toc = {\n");
    AppendTocString(script, "link", ": ", 1, false, layout);
    AppendTocString(script, CStringOf(toc["link"]), ",", 0, layout.lineBreaks, layout);
    AppendTocString(script, "title", ": ", 1, false, layout);
    AppendTocString(script, CStringOf(toc["title"]), ",", 0, layout.lineBreaks, layout);
    AppendTocString(script, "children", ": [", 1, layout.lineBreaks, layout);
    if (const rapidjson::Value* children = FindMember(toc, "children"))
    {
        AppendTocValue(script, *children, 2, layout);
    }
    AppendText(script, "]};\n");
    return script;
}

void AppendTocValue(TextBuffer& script, const rapidjson::Value& value, int indent,
                    const TocScriptLayout& layout)
{
    if (value.IsObject())
    {
        AppendNode(script, value, indent, layout);
    }
    else if (value.IsArray())
    {
        AppendTocNodes(script, value, indent, layout);
    }
}

void AppendTocString(TextBuffer& script, const char* text, const char* extra, int indent, bool newLine,
                     const TocScriptLayout& layout)
{
    AppendIndent(script, indent, layout);
    AppendTitleLiteral(script, text);
    AppendText(script, extra);
    if (newLine)
    {
        AppendText(script, "\n");
    }
}
