#pragma once

#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/PagemeldCheck/Report/Report.h"
#include "Tools/DocTools/VantorPagemeld/Check/StructureFault.h"

#include <map>
#include <string>
#include <string_view>
#include <vector>

/// Collects what is found in one file. A file can have 100,000 faults, so all are counted, but messages and
/// places are made only for those that are shown.
class FileFindings
{
public:
    /// The scope must outlive this object.
    explicit FileFindings(const FileScope& scope) : m_scope(scope) {}

    [[nodiscard]] const FileScope& Scope() const { return m_scope; }

    /// Returns a text as messages quote it.
    [[nodiscard]] std::string Quote(std::string_view text) const
    {
        return Quoted(text, m_scope.options.quoteSize);
    }

    /// Adds what is wrong with a value, in the words that wording() returns. The value must stay
    /// valid and in place until HandTo.
    template <typename Wording>
    void AddAtValue(Rule rule, const rapidjson::Value& value, const JsonPointer& pointer,
                    const Wording& wording)
    {
        if (Item* item = AddItem(rule))
        {
            item->finding.message = wording();
            item->finding.pointer = pointer.Text();
            item->value = &value;
        }
    }

    /// Adds what is wrong at a byte of the text, or with the file as a whole.
    void Add(Rule rule, std::string message, std::optional<std::size_t> offset = std::nullopt);

    /// Hands all findings to the report, after looking up the lines of those that have a place. document is
    /// what ParseJson made of text.
    void HandTo(Report& report, const char* text, const rapidjson::Value& document);

private:
    struct Item
    {
        Finding finding;
        const rapidjson::Value* value = nullptr;
        std::optional<std::size_t> offset = std::nullopt;
    };

    [[nodiscard]] Item* AddItem(Rule rule);
    void Locate(const char* text, const rapidjson::Value& document);
    void AddCounts(Report& report) const;

    struct OrderByName
    {
        bool operator()(Rule a, Rule b) const { return std::string_view(RowOf(a).name) < RowOf(b).name; }
    };

    const FileScope& m_scope;
    std::vector<Item> m_items;
    std::map<Rule, std::size_t, OrderByName> m_counts;
};
