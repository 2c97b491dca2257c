#pragma once

#include "Tools/DocTools/PagemeldCheck/MergedContents.h"
#include "Tools/DocTools/PagemeldCheck/Report/Report.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

#include <optional>
#include <set>
#include <string>
#include <vector>

/// The outcome of reading an input file, and what the checks of a whole set need from it.
struct InputFacts
{
    enum class State
    {
        Missing,
        Unreadable,
        Refused, ///< not JSON, or of the wrong structure: pagemeld skips the module
        Sound,
    };

    State state = State::Missing;

    std::set<std::string> commonWords; ///< of a sound index

    // Of the root of a sound toc, as pagemeld compares them: up to the first NUL.
    std::string rootLink;
    std::string rootTitle;
    std::vector<ValuePlace> rootPlaces; ///< of link and title, if the root is the first or differs from it

    [[nodiscard]] bool IsSound() const { return state == State::Sound; }
    [[nodiscard]] EntryKey Root() const { return {rootLink.c_str(), rootTitle.c_str()}; }
};

/// What the modules that were checked before have brought to the set.
struct EarlierModules
{
    bool hasCommonWords = false;
    std::optional<InputFacts> firstContents;
    MergedContents contents;
};

/// Reads the file of the scope, reports everything that is wrong in it, and returns the outcome. A
/// file that is missing or can't be read is left to the caller to report. Adds what it holds to that of
/// earlier modules.
InputFacts CheckInput(const FileScope& scope, EarlierModules& earlier, Report& report);
