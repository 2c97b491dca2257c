#pragma once

#include "tests/support/Files.h"
#include "tests/support/ParsedJson.h"
#include "tests/support/TemporaryDirectory.h"

#include <list>
#include <vector>

/// A combiner that has combined modules made of the given texts, module 0 first. It trusts their structure.
template <class Combiner>
class MergedModules
{
public:
    explicit MergedModules(const std::vector<std::string>& modules)
    {
        const TemporaryDirectory directory;
        std::list<std::string> paths;
        for (const std::string& json : modules)
        {
            paths.push_back(directory / std::to_string(paths.size()));
            WriteFile(paths.back() + "/module.json", json);
        }
        (void)m_combiner.CombineJson(paths, "module.json");
    }

    Combiner& Get() { return m_combiner; }

    /// Returns the combined document as compact JSON.
    [[nodiscard]] std::string Json() const
    {
        return RapidJsonIoUtil::OutputJsonValueToString(m_combiner.combinedDocument);
    }

private:
    class TrustingCombiner : public Combiner
    {
    public:
        bool VerifyJSONStructure(const rapidjson::Value& /*document*/) override { return true; }
    };

    TrustingCombiner m_combiner;
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
