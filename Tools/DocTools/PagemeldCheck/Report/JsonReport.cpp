#include "Tools/DocTools/PagemeldCheck/Report/JsonReport.h"

#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"

#include <rapidjson/stringbuffer.h>
#include <rapidjson/writer.h>

#include <algorithm>

namespace
{

// In ASCII, so that no control character above it reaches a terminal.
using JsonWriter = rapidjson::Writer<rapidjson::StringBuffer, rapidjson::UTF8<>, rapidjson::ASCII<>>;

/// Writes a text that may hold bytes that are not UTF-8, which become escapes.
void WriteString(JsonWriter& writer, const std::string& text)
{
    std::string valid;
    for (std::size_t start = 0; start < text.size();)
    {
        const std::string_view rest = std::string_view(text).substr(start);
        const std::size_t invalid = std::min(FindInvalidUtf8(rest), rest.size());
        valid += rest.substr(0, invalid);
        start += invalid;
        if (start < text.size())
        {
            valid += Visible(std::string_view(text).substr(start++, 1));
        }
    }
    writer.String(valid.c_str(), static_cast<rapidjson::SizeType>(valid.size()));
}

void WriteMember(JsonWriter& writer, const char* name, const std::string& text)
{
    writer.Key(name);
    WriteString(writer, text);
}

void WriteMember(JsonWriter& writer, const char* name, std::size_t number)
{
    writer.Key(name);
    writer.Uint64(number);
}

void WriteNames(JsonWriter& writer, const char* name, const std::vector<std::string>& modules)
{
    writer.Key(name);
    writer.StartArray();
    for (const std::string& module : modules)
    {
        WriteString(writer, module);
    }
    writer.EndArray();
}

/// Returns JSON with the control character that the library's writer leaves as it is as an escape.
std::string WithoutDelete(std::string json)
{
    for (std::size_t i = json.find('\x7F'); i != std::string::npos; i = json.find('\x7F', i))
    {
        json.replace(i, 1, "\\u007F");
    }
    return json;
}

} // namespace

std::string JsonLine(const Finding& finding, const std::vector<std::string>& roots)
{
    const RuleRow& rule = RowOf(finding.rule);
    rapidjson::StringBuffer buffer;
    JsonWriter writer(buffer);
    writer.StartObject();
    WriteMember(writer, "level", NameOf(rule.level));
    WriteMember(writer, "rule", rule.name);
    if (!finding.file.empty())
    {
        WriteMember(writer, "file", finding.file);
    }
    if (finding.place)
    {
        WriteMember(writer, "line", finding.place->line);
        WriteMember(writer, "column", finding.place->column);
        WriteMember(writer, "offset", finding.place->offset);
    }
    if (finding.pointer)
    {
        WriteMember(writer, "pointer", *finding.pointer);
    }
    if (finding.module)
    {
        WriteMember(writer, "module", roots[*finding.module]);
    }
    if (finding.set)
    {
        WriteMember(writer, "set", NameOf(*finding.set));
    }
    if (finding.more != 0)
    {
        WriteMember(writer, "more", finding.more);
    }
    WriteMember(writer, "message", finding.message);
    writer.EndObject();
    return WithoutDelete(buffer.GetString());
}

std::string JsonSummary(const Summary& summary)
{
    rapidjson::StringBuffer buffer;
    JsonWriter writer(buffer);
    writer.StartObject();
    writer.Key("summary");
    writer.StartObject();
    WriteMember(writer, "modules", summary.modules);
    WriteMember(writer, "errors", summary.CountOf(Level::Error));
    WriteMember(writer, "warnings", summary.CountOf(Level::Warning));
    WriteMember(writer, "notes", summary.CountOf(Level::Note));
    writer.Key("missing");
    writer.StartObject();
    for (const auto& set : kDocSets)
    {
        const auto& [search, contents] = summary.missing[static_cast<std::size_t>(set.id)];
        writer.Key(set.name);
        writer.StartObject();
        WriteNames(writer, "search", search);
        WriteNames(writer, "contents", contents);
        writer.EndObject();
    }
    writer.EndObject();
    writer.EndObject();
    writer.EndObject();
    return WithoutDelete(buffer.GetString());
}
