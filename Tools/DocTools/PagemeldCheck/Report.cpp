#include "Tools/DocTools/PagemeldCheck/Report.h"

#include "Tools/DocTools/PagemeldCheck/ShownText.h"

#include <rapidjson/stringbuffer.h>
#include <rapidjson/writer.h>

#include <algorithm>
#include <cstdint>
#include <tuple>

namespace
{

// In ASCII, so that no control character above it reaches a terminal.
using JsonWriter = rapidjson::Writer<rapidjson::StringBuffer, rapidjson::UTF8<>, rapidjson::ASCII<>>;

/// Findings without a module come last, those without a set before the sets, a count after what it counts.
auto OrderOf(const Finding& finding)
{
    return std::make_tuple(finding.module.value_or(SIZE_MAX), finding.set ? *finding.set + 1 : 0,
                           std::string_view(finding.file), finding.place ? finding.place->offset : SIZE_MAX);
}

const char* ColorOf(Level level)
{
    switch (level)
    {
    case Level::Error:
        return "\033[1;31m";
    case Level::Warning:
        return "\033[1;35m";
    default:
        return "\033[1;36m";
    }
}

/// Writes a text that may hold bytes that are no UTF-8, which become escapes.
void WriteText(JsonWriter& writer, const std::string& text)
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
    WriteText(writer, text);
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
        WriteText(writer, module);
    }
    writer.EndArray();
}

std::string JsonLine(const Finding& finding, const std::vector<std::string>& roots)
{
    rapidjson::StringBuffer buffer;
    JsonWriter writer(buffer);
    writer.StartObject();
    WriteMember(writer, "level", NameOf(finding.rule->level));
    WriteMember(writer, "rule", finding.rule->id);
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
        WriteMember(writer, "set", kSetNames[*finding.set]);
    }
    WriteMember(writer, "message", finding.message);
    writer.EndObject();
    return buffer.GetString();
}

/// Returns a pointer after a space, cut if it is long; nothing for the root.
std::string ShownPointer(const std::string& pointer)
{
    constexpr std::size_t kLongPointer = 200;
    const std::string shown = pointer.empty() ? "" : " " + Visible(pointer.substr(0, kLongPointer));
    return pointer.size() > kLongPointer ? shown + "..." : shown;
}

std::string TextLine(const Finding& finding, const ReportForm& form)
{
    std::string line = finding.file.empty() && finding.set ? kSetNames[*finding.set] : Visible(finding.file);
    if (finding.place)
    {
        line += ":" + std::to_string(finding.place->line) + ":" + std::to_string(finding.place->column);
    }
    const std::string level = NameOf(finding.rule->level);
    line += line.empty() ? "" : ": ";
    line += form.isColored ? ColorOf(finding.rule->level) + level + ":\033[0m " : level + ": ";
    line += finding.message + " [" + finding.rule->id + "]";
    return line + ShownPointer(finding.pointer.value_or(""));
}

/// Returns the names of modules with commas between them.
std::string Joined(const std::vector<std::string>& roots)
{
    std::string text;
    for (const std::string& name : roots)
    {
        text += (text.empty() ? "" : ", ") + Visible(NameOfRoot(name));
    }
    return text;
}

std::string Counted(std::size_t count, const char* noun)
{
    return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

} // namespace

void Report::Add(Finding finding)
{
    Count(*finding.rule, 1);
    m_findings.push_back(std::move(finding));
}

void Report::Count(const Rule& rule, std::size_t findings)
{
    m_counts[rule.level] += findings;
}

void Report::Print(std::FILE* stream, const ReportForm& form, const std::vector<std::string>& roots)
{
    Sort();
    for (const Finding& finding : m_findings)
    {
        const Level lowest = form.countsWarningsAsErrors ? Level::Warning : Level::Error;
        if (form.showsErrorsOnly && finding.rule->level > lowest)
        {
            continue;
        }
        const std::string line = form.isJson ? JsonLine(finding, roots) : TextLine(finding, form);
        (void)std::fprintf(stream, "%s\n", line.c_str());
    }
    if (form.isJson)
    {
        (void)std::fprintf(stream, "%s\n", JsonSummary(roots.size()).c_str());
    }
    else if (!form.showsErrorsOnly)
    {
        (void)std::fprintf(stream, "%s\n", TextSummary(roots.size()).c_str());
    }
}

bool Report::HasErrors(const ReportForm& form) const
{
    return CountOf(Level::Error) > 0 || (form.countsWarningsAsErrors && CountOf(Level::Warning) > 0);
}

std::size_t Report::CountOf(Level level) const
{
    const auto found = m_counts.find(level);
    return found == m_counts.end() ? 0 : found->second;
}

void Report::Sort()
{
    std::stable_sort(m_findings.begin(), m_findings.end(),
                     [](const Finding& a, const Finding& b) { return OrderOf(a) < OrderOf(b); });
}

std::string Report::TextSummary(std::size_t moduleCount) const
{
    std::string summary = Counted(moduleCount, "module") + ", " + Counted(CountOf(Level::Error), "error") +
                          ", " + Counted(CountOf(Level::Warning), "warning");
    std::string missing;
    for (std::size_t set = 0; set < 2; ++set)
    {
        const auto& [search, contents] = m_missing[set];
        const std::string setName = kSetNames[set];
        if (!search.empty())
        {
            missing += (missing.empty() ? "; missing from the search of " : "; from the search of ") +
                       setName + ": " + Joined(search);
        }
        if (!contents.empty())
        {
            const std::string of = search.empty() ? "the contents of " + setName : "its contents";
            missing += (missing.empty() ? "; missing from " : "; from ") + of + ": " + Joined(contents);
        }
    }
    return summary + missing;
}

std::string Report::JsonSummary(std::size_t moduleCount) const
{
    rapidjson::StringBuffer buffer;
    JsonWriter writer(buffer);
    writer.StartObject();
    writer.Key("summary");
    writer.StartObject();
    WriteMember(writer, "modules", moduleCount);
    WriteMember(writer, "errors", CountOf(Level::Error));
    WriteMember(writer, "warnings", CountOf(Level::Warning));
    WriteMember(writer, "notes", CountOf(Level::Note));
    writer.Key("missing");
    writer.StartObject();
    for (std::size_t set = 0; set < 2; ++set)
    {
        writer.Key(kSetNames[set]);
        writer.StartObject();
        WriteNames(writer, "search", m_missing[set].search);
        WriteNames(writer, "contents", m_missing[set].contents);
        writer.EndObject();
    }
    writer.EndObject();
    writer.EndObject();
    writer.EndObject();
    return buffer.GetString();
}
