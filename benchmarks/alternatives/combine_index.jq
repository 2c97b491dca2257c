# Combines search indexes: the index part of what pagemeld does with sound input, for one documentation set.
# Usage: jq --null-input --join-output --indent 4 --from-file combine_index.jq <index.json> ...

# Appends to the term's numbers. In jq 1.6 the usual `.[$term] += $numbers` copies the whole object each time.
def append($term; $numbers): setpath([$term]; getpath([$term]) + $numbers);

reduce inputs as $document ({moduleCount: 0, pages: [], info: [], common: {}, searchIndex: {}};
    .moduleCount as $tag
    | (.pages | length) as $pageOffset
    | (.info | length) as $infoOffset
    | .pages += ($document.pages | map(. + [$tag]))
    | .info += ($document.info | map([.[0], .[1] + $pageOffset]))
    | .common = (if .common == {} then $document.common else .common end)
    | .searchIndex = reduce ($document.searchIndex | to_entries[]) as {key: $term, value: $numbers} (.searchIndex;
        append($term; $numbers | map(. + $infoOffset)))
    | .moduleCount += 1)
| del(.moduleCount)
