#pragma once

#include "Tools/DocTools/VantorPagemeld/Check/StructureFault.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"
#include "fuzz/Property.h"
#include "tests/support/MergedModules.h"

// What the merges of search indexes and of tables of contents have in common.

/// Returns whether a structure check accepts the document. Requires that it accepts exactly what has no
/// fault.
template <class Check>
bool IsSound(Check check, const rapidjson::Value& document)
{
    int faults = 0;
    Require(
        check(document, [&](const FoundFault& found) { return (void)found.pointer.Text(), ++faults > 0; }),
        "a check that is told to go on does");
    const bool sound = check(document, [](const FoundFault&) { return false; });
    Require(sound == (faults == 0), "the first fault and all faults agree");
    return sound;
}

/// Merges those of the texts that are sound, by the combiner and by a plain merge. Requires that the results
/// are equal, and hands over the combiner's.
template <class PlainMerge, class Combiner, class Check, class Handler>
void MergeLikePlain(Check check, const std::vector<std::string>& texts, Handler handleMerged)
{
    PlainMerge plain;
    std::vector<std::string> soundTexts;
    for (const std::string& text : texts)
    {
        rapidjson::Document document;
        if (!ParseJson(text.c_str(), document).IsError() && IsSound(check, document))
        {
            plain.Append(document, static_cast<int>(soundTexts.size()));
            soundTexts.push_back(text);
        }
    }
    MergedModules<Combiner> merged(soundTexts);
    Require(IsSameValue(merged.Get().combinedDocument, plain.Merged()), "the merge equals the plain one");
    handleMerged(merged.Get().combinedDocument);
}
