#pragma once

#include "Tools/DocTools/PagemeldCheck/Report/FileFindings.h"

/// Reports which of the members that count at the top of a file it has twice. The document is any.
void CheckTopMembers(const rapidjson::Value& document, FileFindings& findings);

/// Checks the common words and the terms of a sound index as the scripts hold them and as readers look them
/// up. commonWordsCount tells whether a run takes this module's common words.
void CheckWords(const rapidjson::Value& index, bool commonWordsCount, FileFindings& findings);
