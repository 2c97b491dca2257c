#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/FileFindings.h"

/// What is checked in a sound file's texts besides the scripts.
struct TextChecks
{
    bool checksTargets = false; ///< whether page paths and links lead to files
    std::string setDirectory;   ///< which they are relative to
};

/// Checks the titles, page paths and terms of a sound search index as the script would hold them.
void CheckIndexTexts(const rapidjson::Value& index, const TextChecks& checks, FileFindings& findings);

/// Checks the titles and links of a sound table of contents as the script would hold them.
void CheckTocTexts(const rapidjson::Value& toc, const TextChecks& checks, FileFindings& findings);
