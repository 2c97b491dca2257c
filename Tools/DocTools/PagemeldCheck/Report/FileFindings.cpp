#include "Tools/DocTools/PagemeldCheck/Report/FileFindings.h"

void FileFindings::Add(Rule rule, std::string message, std::optional<std::size_t> offset)
{
    if (Item* item = AddItem(rule))
    {
        item->finding.message = std::move(message);
        item->offset = offset;
    }
}

void FileFindings::HandTo(Report& report, const char* text, const rapidjson::Value& document)
{
    Locate(text, document);
    for (Item& item : m_items)
    {
        report.Add(std::move(item.finding));
    }
    AddCounts(report);
    m_items.clear();
    m_counts.clear();
}

FileFindings::Item* FileFindings::AddItem(Rule rule)
{
    const std::size_t limit = m_scope.options.limit;
    if (++m_counts[rule] > limit && limit != 0)
    {
        return nullptr;
    }
    return &m_items.emplace_back(Item{Finding::OfFile(rule, m_scope.file, "")});
}

void FileFindings::Locate(const char* text, const rapidjson::Value& document)
{
    std::vector<const rapidjson::Value*> values;
    for (const Item& item : m_items)
    {
        if (item.value != nullptr)
        {
            values.push_back(item.value);
        }
    }
    std::vector<ValuePlace> places;
    if (!values.empty())
    {
        places = LocateValues(text, document, values);
    }
    auto place = places.begin();
    for (Item& item : m_items)
    {
        if (item.value != nullptr)
        {
            item.finding.place = *place++;
        }
        else if (item.offset)
        {
            item.finding.place = PlaceOfOffset(text, *item.offset);
        }
    }
}

void FileFindings::AddCounts(Report& report) const
{
    const std::size_t limit = m_scope.options.limit;
    for (const auto& [rule, count] : m_counts)
    {
        if (limit != 0 && count > limit)
        {
            const std::size_t hidden = count - limit;
            Finding finding = Finding::OfFile(
                rule, m_scope.file, std::to_string(hidden) + " more of this rule; --limit=0 shows all");
            finding.more = hidden;
            report.Add(std::move(finding));
            report.Count(rule, hidden - 1);
        }
    }
}
