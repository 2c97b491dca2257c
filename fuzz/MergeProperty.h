#pragma once

#include "Tools/DocTools/VantorPagemeld/Json/JsonReader.h"
#include "Tools/DocTools/VantorPagemeld/Structure/JsonPlace.h"
#include "Tools/DocTools/VantorPagemeld/Structure/StructureFault.h"
#include "fuzz/Property.h"

#include <list>

// What the merges of search indexes and of tables of contents have in common.

/// Returns whether a structure check accepts the document, and requires that it finds no fault just then.
template <class Check>
bool IsSound(Check check, const rapidjson::Value& document)
{
    int faults = 0;
    Require(check(document, [&](const StructureFault&, const JsonPlace& place)
                  { return (void)place.ToPointer(), ++faults > 0; }),
            "a check that is told to go on does");
    const bool sound = check(document, [](const StructureFault&, const JsonPlace&) { return false; });
    Require(sound == (faults == 0), "the first fault and all faults agree");
    return sound;
}

/// Merges those of the texts that are sound into the combiner, and requires that the result equals a plain
/// merge. The documents hold the values of the result. Returns how many were merged.
template <class PlainMerge, class Combiner, class Check>
int MergeLikePlain(Combiner& combiner, std::list<rapidjson::Document>& documents, Check check,
                   const std::vector<std::string>& texts)
{
    PlainMerge plain;
    int moduleIndex = 0;
    for (const std::string& text : texts)
    {
        rapidjson::Document& document = documents.emplace_back();
        if (!ParseJson(text.c_str(), document).IsError() && IsSound(check, document))
        {
            plain.Append(document, moduleIndex);
            combiner.AddModuleIndexToEachEntry(document, moduleIndex);
            combiner.AppendJsonDocument(document);
            ++moduleIndex;
        }
    }
    Require(IsSameValue(combiner.combinedDocument, plain.Merged()), "the merge equals the plain one");
    return moduleIndex;
}
