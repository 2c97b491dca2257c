#include "Tools/DocTools/PagemeldCheck/Report/Rules.h"

#include "Tools/DocTools/VantorPagemeld/System/EnumTable.h"

#include <algorithm>
#include <iterator>

namespace
{

constexpr RuleRow kRules[] = {
    {Rule::NoModules, Level::Error, "no-modules", "--discover found no module, or none of the roots is one",
     "Nothing is combined; earlier outputs stay, and the run ends with status 0.",
     "A module is the directory above Manual/docdata and ScriptReference/docdata. Give the modules, or with "
     "--discover a directory above them."},
    {Rule::MissingRoot, Level::Error, "missing-root", "a root does not exist",
     "The run ends with status 255 where it comes to its outputs, and later modules stay unwritten.",
     "Correct the path, or leave it out."},
    {Rule::DuplicateRoot, Level::Error, "duplicate-root", "two roots or sets are the same directory",
     "Pages are in the search twice, links may be those of either name, and the outputs of one replace those "
     "of the other.",
     "Give each module once, and each set a directory of its own."},
    {Rule::PassedOver, Level::Warning, "passed-over",
     "a directory looks like a module, but --discover does not take it",
     "The module is missing from search and contents, and receives no outputs.",
     "Rename it if its name begins with a dot, replace a link by the directory, add Manual/docdata, or "
     "give the roots by name."},
    {Rule::OutputBlocked, Level::Error, "output-blocked", "an output can't be written",
     "For global_index.js the run ends there with status 255, and later modules stay unwritten; any "
     "other output stays as it was.",
     "Create the docdata directory, make it writable, and remove what is in the way of the output or of "
     "its temporary file."},
    {Rule::WrongLinkPath, Level::Error, "wrong-link-path",
     "links from one module to another lead to the wrong place",
     "The links are dead, or lead to another module. Prefixes are computed on the paths as typed.",
     "Rename a module whose name begins with another's, give absolute roots, put no slash at their end, "
     "and keep quotes, backslashes and line breaks out of their names."},
    {Rule::Unreadable, Level::Error, "unreadable",
     "one of the two files of a set is missing, or can't be read",
     "The module is missing from the search (index.json) or from the contents (toc.json).",
     "Create the file or make it readable."},
    {Rule::SetEmpty, Level::Note, "set-empty",
     "a module has the docdata directory of a set, but neither file",
     "The module adds nothing to the set; it receives the outputs.",
     "Nothing needs to be done if the module has no such documentation."},
    {Rule::NothingToCombine, Level::Error, "nothing-to-combine",
     "no module of the set has a sound index, or no module has sound contents",
     "Nothing is written for the set, and earlier outputs stay.",
     "Fix at least one index.json and one toc.json of the set."},
    {Rule::NotJson, Level::Error, "not-json", "a file is not JSON, or exceeds a limit of the reader",
     "The module is missing from the search (index.json) or from the contents (toc.json).",
     "Fix the text at the place shown; write the file with a JSON library."},
    {Rule::Structure, Level::Error, "structure", "a file breaks its format",
     "The module is missing from the search (index.json) or from the contents (toc.json); the run names "
     "the first such fault only.",
     "Fix every entry shown; docs/FORMATS.md has the formats."},
    {Rule::MergedInput, Level::Error, "merged-input", "an input is an output of an earlier run",
     "An index.json is refused, and the module is missing from the search. A sound toc.json is taken, "
     "and its links lead to other modules than they should.",
     "Put the module's own file in its place."},
    {Rule::RootDiffers, Level::Error, "root-differs",
     "the root of a toc.json differs from that of the first module",
     "The module is missing from the contents, without a message.",
     "Give the roots of all modules the same link and title."},
    {Rule::ShadowedEntry, Level::Warning, "shadowed-entry",
     "an entry of the contents has the link and title of an earlier module's",
     "The two become one entry, which leads to the earlier module's page and holds the sub-entries of both: "
     "this "
     "module's page is not reached by it.",
     "Give the entry a title or link of its own, or the link \"null\" if it is a group that modules share."},
    {Rule::ScriptBroken, Level::Error, "script-broken",
     "a title, page path, link or common word is a fault in the scripts",
     "The script is a syntax error in every module: nobody can search, or nobody sees the contents.",
     "Replace the backslash, quote or line break by another character; leave __proto__ out."},
    {Rule::ScriptAltered, Level::Warning, "script-altered",
     "a title, page path or link has another value in the scripts",
     "Readers see another title, or are led elsewhere.",
     "Replace the backslash by another character, and remove NUL characters."},
    {Rule::PrefixedUrl, Level::Warning, "prefixed-url",
     "a page path or link is an absolute URL (https://...)",
     "The module's prefix is put before it, so the link is dead unless the page script removes it.",
     "Link to a page of the module, or use the page script."},
    {Rule::SpecialTerm, Level::Warning, "special-term", "__proto__ is a term or common word",
     "In the scripts it sets the prototype of the object instead of a member: it is not found.",
     "Leave it out, or use global_index.json."},
    {Rule::UnfoundTerm, Level::Warning, "unfound-term", "a term has capitals, spaces or marks, or is empty",
     "Readers' words are looked up in lower case, split at all but letters, digits and _: they find the term "
     "by its beginning, if at all.",
     "Split terms at all other characters, and write them in lower case."},
    {Rule::DoubledMember, Level::Warning, "doubled-member", "a file has one of its members twice",
     "The first counts; what the other holds is missing without a message.",
     "Join the two, or leave one out."},
    {Rule::InvalidUtf8, Level::Warning, "invalid-utf8", "a file is not UTF-8",
     "Readers see replacement characters, and can't search for the words.", "Save the file as UTF-8."},
    {Rule::TextAfterNul, Level::Warning, "text-after-nul", "bytes after a NUL byte are not seen",
     "What follows is missing without a message.", "Remove the NUL byte; a file in UTF-16 has many."},
    {Rule::CommonIgnored, Level::Note, "common-ignored", "modules of a set have different common words",
     "Those of the first module that has any count for all; the others' are ignored.",
     "Use one list for all modules."},
    {Rule::MissingTarget, Level::Warning, "missing-target", "--targets: a page path or link leads to no file",
     "The link is dead.",
     "Fix the path: it is a file's name, relative to the set's directory, with nothing encoded."},
    {Rule::UnlistedPage, Level::Note, "unlisted-page",
     "--targets: HTML files of a set have no entry in its index", "The search does not find these pages.",
     "Add entries to index.json, unless the pages are left out on purpose."},
    {Rule::OutputMissing, Level::Error, "output-missing", "--outputs: an output is not there",
     "Readers of the module can't search, or see no contents.", "Run pagemeld, and read its messages."},
    {Rule::OutputBroken, Level::Error, "output-broken", "--outputs: an output is cut short or not JSON",
     "Readers of the module can't search, or see no contents.",
     "Free space on the disk and run pagemeld again."},
    {Rule::WrongPrefixes, Level::Error, "wrong-prefixes",
     "--outputs: a script's links were made for other modules, or for other names or places of them",
     "Links lead to the wrong module or nowhere, and modules that came later are not found.",
     "Run pagemeld again, with the same roots as here."},
    {Rule::OutputDiffers, Level::Error, "output-differs",
     "--outputs: an output has other content than in the first module",
     "Readers of different modules find different things: a run ended early.",
     "Run pagemeld again, and look at its exit status."},
    {Rule::OutputStale, Level::Error, "output-stale",
     "--outputs: an output is older than an input of the set", "Readers see the result of an earlier build.",
     "Run pagemeld again."},
    {Rule::Leftover, Level::Error, "leftover", "--outputs: a temporary file is left over",
     "A run was ended, or could not rename the file: the output beside it may be old.",
     "Run pagemeld again; remove a directory that has the output's name."},
};
static_assert(HasRowOfEach(kRules));

} // namespace

const RuleTable& AllRules()
{
    return kRules;
}

const RuleRow& RowOf(Rule rule)
{
    return RowOf(kRules, rule);
}

const RuleRow* FindRule(std::string_view name)
{
    const auto* const found = std::find_if(std::begin(kRules), std::end(kRules),
                                           [&](const RuleRow& rule) { return name == rule.name; });
    return found == std::end(kRules) ? nullptr : found;
}

const char* NameOf(Level level)
{
    switch (level)
    {
    case Level::Error:
        return "error";
    case Level::Warning:
        return "warning";
    default:
        return "note";
    }
}
