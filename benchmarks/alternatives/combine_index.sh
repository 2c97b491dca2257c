#!/bin/sh
# Combines the search indexes of documentation modules with jq, and copies the result into each module.
# Usage: combine_index.sh <module root> ...
set -eu
filter=$(dirname "$0")/combine_index.jq
for set in Manual ScriptReference; do
    combined=$1/$set/docdata/global_index.json
    for root; do
        printf '%s\0' "$root/$set/docdata/index.json"
    done | xargs -0 jq --null-input --join-output --indent 4 --from-file "$filter" > "$combined"
    first=$1
    for root; do
        [ "$root" = "$first" ] || cp "$combined" "$root/$set/docdata/"
    done
done
