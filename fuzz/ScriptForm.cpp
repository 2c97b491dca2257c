#include "fuzz/ScriptForm.h"

#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"
#include "fuzz/Property.h"

#include <cstring>
#include <string>

namespace
{

/// Reads a script from the front. Every operation takes what it expects, or tells that it is not there.
class ScriptReader
{
public:
    explicit ScriptReader(std::string_view script) : m_rest(script) {}

    [[nodiscard]] bool IsAtEnd() const { return m_rest.empty(); }

    bool Take(std::string_view expected)
    {
        const bool found = m_rest.substr(0, expected.size()) == expected;
        m_rest.remove_prefix(found ? expected.size() : 0);
        return found;
    }

    /// A text in quotes that is not escaped.
    bool TakeRaw(const rapidjson::Value& text) { return Take("\"") && Take(text.GetString()) && Take("\""); }

    /// A text in quotes, with a backslash before each quote of its own.
    bool TakeEscaped(const rapidjson::Value& text)
    {
        bool found = Take("\"");
        for (const char* c = text.GetString(); found && *c != '\0'; ++c)
        {
            found = (*c != '"' || Take("\\")) && Take({c, 1});
        }
        return found && Take("\"");
    }

    bool TakePrefixVariable(int module) { return Take("p") && Take(std::to_string(module)); }

    /// One line of compact JSON that holds the value.
    bool TakeJsonLine(const rapidjson::Value& value, std::string_view lineEnd)
    {
        const std::string line(m_rest.substr(0, m_rest.find(lineEnd)));
        rapidjson::Document document;
        return !ParseJson(line.c_str(), document).IsError() && IsSameValue(document, value) &&
               line == RapidJsonIoUtil::OutputJsonValueToString(document) && Take(line) && Take(lineEnd);
    }

private:
    std::string_view m_rest;
};

bool TakePage(ScriptReader& script, const rapidjson::Value& page)
{
    return script.Take("[") && script.TakePrefixVariable(page[2].GetInt()) && script.Take(" + ") &&
           script.TakeRaw(page[0]) && script.Take(", ") && script.TakeEscaped(page[1]) && script.Take("]");
}

bool TakePages(ScriptReader& script, const rapidjson::Value& pages)
{
    bool found = script.Take("pages = [\n");
    for (rapidjson::SizeType i = 0; found && i < pages.Size(); ++i)
    {
        found = TakePage(script, pages[i]) && script.Take(i + 1 == pages.Size() ? "\n" : ",\n");
    }
    return found && script.Take("];\n");
}

bool TakeLink(ScriptReader& script, const rapidjson::Value& node)
{
    for (const auto& member : node.GetObject())
    {
        if (member.name == "module" && member.value.IsInt())
        {
            const bool isGroup = std::strcmp(node["link"].GetString(), "null") == 0;
            return (isGroup || (script.TakePrefixVariable(member.value.GetInt()) && script.Take("+"))) &&
                   script.TakeRaw(node["link"]);
        }
    }
    return script.TakeEscaped(node["link"]);
}

bool TakeNode(ScriptReader& script, const rapidjson::Value& node);

/// The nodes of a list; nothing for null.
bool TakeNodes(ScriptReader& script, const rapidjson::Value& children)
{
    bool found = true;
    for (rapidjson::SizeType i = 0; found && children.IsArray() && i < children.Size(); ++i)
    {
        found = (i == 0 || script.Take(",")) && TakeNode(script, children[i]);
    }
    return found;
}

bool TakeNode(ScriptReader& script, const rapidjson::Value& node)
{
    const rapidjson::Value& children = node["children"];
    return script.Take("{\"link\": ") && TakeLink(script, node) && script.Take(",\"title\": ") &&
           script.TakeEscaped(node["title"]) && script.Take(",\"children\": ") &&
           (children.IsNull() ? script.Take("null")
                              : script.Take("[") && TakeNodes(script, children) && script.Take("]")) &&
           script.Take("}");
}

} // namespace

bool IsIndexScript(std::string_view script, const rapidjson::Value& index)
{
    ScriptReader reader(script);
    return TakePages(reader, index["pages"]) && reader.Take("info = ") &&
           reader.TakeJsonLine(index["info"], "\n") && reader.Take("common = ") &&
           reader.TakeJsonLine(index["common"], ";\n") && reader.Take("searchIndex = ") &&
           reader.TakeJsonLine(index["searchIndex"], ";\n") && reader.IsAtEnd();
}

bool IsTocScript(std::string_view script, const rapidjson::Value& toc)
{
    ScriptReader reader(script);
    return reader.Take("toc = {\n\"link\": ") && reader.TakeEscaped(toc["link"]) &&
           reader.Take(",\"title\": ") && reader.TakeEscaped(toc["title"]) &&
           reader.Take(",\"children\": [") && TakeNodes(reader, toc["children"]) && reader.Take("]};\n") &&
           reader.IsAtEnd();
}
