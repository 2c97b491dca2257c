#pragma once

#include "tests/support/TemporaryDirectory.h"

#include <vector>

/// Returns text with every occurrence of from replaced by to. It makes paths that differ from run to run
/// comparable with a literal.
inline std::string ReplaceAll(std::string text, const std::string& from, const std::string& to)
{
    for (auto at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size()))
    {
        text.replace(at, from.size(), to);
    }
    return text;
}

/// Returns a report with @ for the directory and # for the place of the sources in the tags of messages.
inline std::string WithPlaceholders(const std::string& report, const TemporaryDirectory& directory)
{
    return ReplaceAll(ReplaceAll(report, directory.Path(), "@"), "./Tools/DocTools/VantorPagemeld/", "#");
}

/// Returns the output of self-tests with N for the numbers that differ from run to run: those after the
/// labels.
inline std::string WithoutNumbers(std::string text,
                                  const std::vector<std::string>& labels = {
                                      "PASS(", "failures in ", R"("time":)", R"("processId":)",
                                      R"("durationMicroseconds":)", R"("duration":)"})
{
    for (const std::string& label : labels)
    {
        for (std::size_t at = text.find(label); at != std::string::npos; at = text.find(label, at + 1))
        {
            const std::size_t start = at + label.size();
            text.replace(start, text.find_first_not_of("0123456789.", start) - start, "N");
        }
    }
    return text;
}
