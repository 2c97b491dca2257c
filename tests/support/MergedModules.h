#pragma once

#include "tests/support/ParsedJson.h"

#include <memory>
#include <vector>

/// A combiner that has tagged and merged the given texts, module 0 first, together with their documents.
template <class Combiner>
class MergedModules
{
public:
    explicit MergedModules(const std::vector<std::string>& modules)
    {
        for (const std::string& json : modules)
        {
            Merge(json);
        }
    }

    Combiner& Get() { return m_combiner; }

    /// Returns the combined document as compact JSON.
    [[nodiscard]] std::string Json() const
    {
        return RapidJsonIoUtil::OutputJsonValueToString(m_combiner.combinedDocument);
    }

private:
    void Merge(const std::string& json)
    {
        const int moduleIndex = static_cast<int>(m_documents.size());
        m_documents.push_back(std::make_unique<rapidjson::Document>(ParsedJson(json)));
        m_combiner.AddModuleIndexToEachEntry(*m_documents.back(), moduleIndex);
        m_combiner.AppendJsonDocument(*m_documents.back());
    }

    std::vector<std::unique_ptr<rapidjson::Document>> m_documents; // hold values of the combined document
    Combiner m_combiner;
};

/// Returns all elements with a comma between them.
inline std::string Joined(const std::vector<std::string>& elements)
{
    std::string text;
    for (const std::string& element : elements)
    {
        text += (text.empty() ? "" : ",") + element;
    }
    return text;
}
