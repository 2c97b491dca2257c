#pragma once

#include "tests/support/TemporaryFolder.h"

/// Returns text with every occurrence of from replaced by to: paths that differ from run to run by a sign
/// that stands in a literal.
inline std::string ReplaceAll(std::string text, const std::string& from, const std::string& to)
{
    for (auto at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size()))
    {
        text.replace(at, from.size(), to);
    }
    return text;
}

/// Returns a report with @ for the folder and # for the place of the sources in the tags of messages.
inline std::string Neutral(const std::string& report, const TemporaryFolder& folder)
{
    return ReplaceAll(ReplaceAll(report, folder.Path(), "@"), "./Tools/DocTools/VantorPagemeld/", "#");
}
