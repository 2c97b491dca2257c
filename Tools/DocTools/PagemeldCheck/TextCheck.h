#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/FileFindings.h"

/// Checks the titles, page paths and terms of a sound search index as the script would hold them.
void CheckIndexTexts(const rapidjson::Value& index, FileFindings& findings);

/// Checks the titles and links of a sound table of contents as the script would hold them.
void CheckTocTexts(const rapidjson::Value& toc, FileFindings& findings);
