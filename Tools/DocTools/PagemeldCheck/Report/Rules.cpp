#include "Tools/DocTools/PagemeldCheck/Report/Rules.h"

#include <algorithm>
#include <iterator>

namespace
{

constexpr RuleRow kRules[] = {
    {Rule::NoModules, Level::Error, "no-modules", "no root is a module, or --discover finds none",
     "Nothing is combined, with status 0; earlier outputs stay.",
     "Give directories that hold Manual/docdata, or with --discover one above them."},
    {Rule::MissingRoot, Level::Error, "missing-root", "a root does not exist",
     "The run ends there with status 255; later modules stay unwritten.",
     "Correct the path, or leave it out."},
    {Rule::DuplicateRoot, Level::Error, "duplicate-root", "two roots or sets are the same directory",
     "Pages are found twice, and outputs replace each other.",
     "Give each module once, and each set its own directory."},
    {Rule::PassedOver, Level::Warning, "passed-over", "--discover does not take what looks like a module",
     "It is missing for readers, and gets no outputs.",
     "Rename, move or complete it, replace a link by the directory, or give the roots by name."},
    {Rule::OutputBlocked, Level::Error, "output-blocked", "an output can't be written",
     "At global_index.js the run ends with status 255; any other output stays as it was.",
     "Create docdata, make it writable, and clear the way of the output and its .tmp file."},
    {Rule::WrongLinkPath, Level::Error, "wrong-link-path", "links between modules lead to the wrong place",
     "They are dead, or lead to another module.",
     "Give absolute roots without a slash at the end; rename modules whose names begin with another's or "
     "have special characters."},
    {Rule::Unreadable, Level::Error, "unreadable", "one of a set's two files is missing or can't be read",
     "The module is missing from the search (index.json) or the contents (toc.json).",
     "Create the file, or make it readable."},
    {Rule::SetEmpty, Level::Note, "set-empty", "a module has the docdata of a set, but neither file",
     "It adds nothing to the set, and gets outputs.", "Nothing, if it has no such documentation."},
    {Rule::NothingToCombine, Level::Error, "nothing-to-combine",
     "no module of a set has a sound index, or none sound contents",
     "Nothing is written; earlier outputs stay.", "Fix at least one index.json and one toc.json."},
    {Rule::NotJson, Level::Error, "not-json", "a file is not JSON, or exceeds a limit of the reader",
     "The module is missing from search or contents.", "Fix the text at the place shown."},
    {Rule::Structure, Level::Error, "structure", "a file breaks its format",
     "The module is missing from search or contents.", "Fix every entry shown; pagemeld(5) has the formats."},
    {Rule::MergedInput, Level::Error, "merged-input", "an input is an output of an earlier run",
     "The module is missing from the search, or its contents lead to other modules.",
     "Put the module's own file in its place."},
    {Rule::RootDiffers, Level::Error, "root-differs",
     "the root of a toc.json differs from the first module's",
     "The module is missing from the contents, without a message.",
     "Give all roots the same link and title."},
    {Rule::ShadowedEntry, Level::Warning, "shadowed-entry",
     "an entry of contents has the link and title of an earlier module's",
     "They become one, which leads to the earlier module's page.",
     "Give it its own title or link, or the link \"null\" if it is a group that modules share."},
    {Rule::ScriptBroken, Level::Error, "script-broken",
     "a title, path, link or common word is a fault in a script",
     "In every module nobody can search, or nobody sees the contents.",
     "Replace the backslash, quote or line break; leave __proto__ out."},
    {Rule::ScriptAltered, Level::Warning, "script-altered",
     "a title, path or link has another value in the scripts",
     "Readers see another title, or are led elsewhere.", "Replace backslashes, and remove NUL characters."},
    {Rule::PrefixedUrl, Level::Warning, "prefixed-url", "a path or link is an absolute URL (https://...)",
     "It gets the module's prefix, and is dead without the page script.", "Link to a page of the module."},
    {Rule::SpecialTerm, Level::Warning, "special-term", "__proto__ is a term or common word",
     "In the scripts it is not found.", "Leave it out."},
    {Rule::UnfoundTerm, Level::Warning, "unfound-term", "a term has capitals, spaces or marks, or is empty",
     "Readers' words are in lower case, and split at all but letters, digits and _.",
     "Write terms in lower case, and split them so."},
    {Rule::DoubledMember, Level::Warning, "doubled-member", "a file has one of its members twice",
     "The second is ignored, without a message.", "Join the two, or leave one out."},
    {Rule::InvalidUtf8, Level::Warning, "invalid-utf8",
     "a file is not UTF-8, or has half of a surrogate pair",
     "Readers see replacement characters; other programs may refuse the JSON outputs.",
     "Save it as UTF-8; write both halves or neither."},
    {Rule::TextAfterNul, Level::Warning, "text-after-nul", "a NUL byte ends the text of a file",
     "What follows is missing, without a message.", "Remove it; a file in UTF-16 has many."},
    {Rule::CommonIgnored, Level::Note, "common-ignored", "modules of a set have different common words",
     "Those of the first module that has any count for all.", "Use one list for all modules."},
    {Rule::MissingTarget, Level::Warning, "missing-target", "--targets: a path or link leads to no file",
     "The link is dead.", "Give the file's name below the set's directory, with nothing encoded."},
    {Rule::UnlistedPage, Level::Note, "unlisted-page",
     "--targets: HTML files of a set have no entry in its index", "The search does not find them.",
     "Add them to index.json, or leave them out on purpose."},
    {Rule::OutputMissing, Level::Error, "output-missing", "--outputs: an output is not there",
     "Readers of the module can't search, or see no contents.", "Run pagemeld, and read its messages."},
    {Rule::OutputBroken, Level::Error, "output-broken", "--outputs: an output is cut short or not JSON",
     "Readers of the module can't search, or see no contents.",
     "Free space on the disk and run pagemeld again."},
    {Rule::WrongPrefixes, Level::Error, "wrong-prefixes",
     "--outputs: a script is for other modules, names or places",
     "Its links lead to the wrong module or nowhere.", "Run pagemeld again, with the same roots."},
    {Rule::OutputDiffers, Level::Error, "output-differs",
     "--outputs: an output differs from the first module's",
     "Readers find different things: a run ended early.", "Run pagemeld again, and look at its exit status."},
    {Rule::OutputStale, Level::Error, "output-stale", "--outputs: an output is older than an input",
     "Readers see an earlier build.", "Correct any date in the future, and run pagemeld again."},
    {Rule::Leftover, Level::Error, "leftover", "--outputs: a temporary file is left over",
     "The output may be old: a run was ended, or could not rename the file.",
     "Run pagemeld again; remove a directory of the output's name."},
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
