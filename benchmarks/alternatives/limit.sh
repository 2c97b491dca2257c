#!/bin/sh
# What no program can beat: reads all inputs of a corpus, and copies finished outputs into all its modules.
# Usage: limit.sh <corpus>, which holds the finished outputs in ready/<documentation set>
set -eu
cat "$1"/m*/*/docdata/index.json "$1"/m*/*/docdata/toc.json > /dev/null
for set in Manual ScriptReference; do
    for docdata in "$1"/m*/"$set"/docdata; do
        cp "$1/ready/$set"/global_* "$docdata"
    done
done
