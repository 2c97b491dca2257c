#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/Report.h"
#include "Tools/DocTools/VantorPagemeld/Check/StructureFault.h"

#include <map>
#include <string>
#include <string_view>
#include <vector>

/// Where a file belongs, and how much of its findings is shown.
struct FileScope
{
    std::size_t module;
    std::size_t set;
    std::string path;
    std::size_t limit;     ///< findings shown per rule; 0 for all
    std::size_t quoteSize; ///< bytes of a text that a message shows
};

/// Collects what is found in one file. Counts everything, but words and locates only what is shown: a file
/// can have 100,000 faults.
class FileFindings
{
public:
    explicit FileFindings(FileScope scope) : m_scope(std::move(scope)) {}

    [[nodiscard]] const FileScope& Scope() const { return m_scope; }

    /// Adds what is wrong with a value, in the words that wording() returns. The value must stay
    /// valid and in place until HandTo.
    template <typename Wording>
    void AddAtValue(const char* rule, const rapidjson::Value& value, const JsonPointer& pointer,
                    const Wording& wording)
    {
        if (Item* item = AddItem(rule))
        {
            item->finding.message = wording();
            item->finding.pointer = pointer.Text();
            item->value = &value;
        }
    }

    /// Adds what is wrong at a byte of the text.
    void AddAtOffset(const char* rule, std::size_t offset, std::string message);

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

    [[nodiscard]] Item* AddItem(const char* rule);
    void Locate(const char* text, const rapidjson::Value& document);
    void AddCounts(Report& report) const;

    FileScope m_scope;
    std::vector<Item> m_items;
    std::map<std::string_view, std::size_t> m_counts; // by rule
};
