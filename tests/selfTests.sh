#!/bin/sh
# Runs the self-tests that are compiled into the program $1. Its exit status says nothing about their outcome, so
# what it prints is compared.
set -eu

program=$1
output=$(mktemp -d)
trap 'rm -r "$output"' EXIT

# Runs the self-tests with the given arguments. Standard output, with every time and process id as N, must be the
# text on standard input; standard error must be empty.
expect() {
    cat >"$output/expected"
    "$program" -runNativeTests "$@" >"$output/printed" 2>"$output/errors" </dev/null
    sed -E 's/(PASS\(|failures in |"(time|processId|duration|durationMicroseconds)":)[0-9.]+/\1N/g' \
        "$output/printed" >"$output/actual"
    diff "$output/expected" "$output/actual"
    diff /dev/null "$output/errors"
}

expect_all() {
    expect "$@" <<'END'
[IndexCombiner]  TryGetJsonDocFromString_ValidString_ReturnsTrue             PASS(Nms)
[IndexCombiner]  AppendJsonDocument_OneValueJson_ProducesThatJson            PASS(Nms)
[IndexCombiner]  AppendJsonDocument_TwoValidJsons_ProducesCombinedJson       PASS(Nms)
[TocCombiner]    TryGetJsonDocFromString_ValidString_ReturnsTrue             PASS(Nms)
[TocCombiner]    AppendJsonDocument_OneValueJson_ProducesThatJson            PASS(Nms)
[TocCombiner]    AppendJsonDocument_TrivialAndSimpleJson_ProducesSimpleJson  PASS(Nms)
Ran 6 tests with 0 failures in N seconds
END
}

expect_all
expect_all ""
expect_all .

expect valid <<'END'
[IndexCombiner]  TryGetJsonDocFromString_ValidString_ReturnsTrue        PASS(Nms)
[IndexCombiner]  AppendJsonDocument_TwoValidJsons_ProducesCombinedJson  PASS(Nms)
[TocCombiner]    TryGetJsonDocFromString_ValidString_ReturnsTrue        PASS(Nms)
Ran 3 tests with 0 failures in N seconds
END

expect indexcombiner.append <<'END'
[IndexCombiner]  AppendJsonDocument_OneValueJson_ProducesThatJson       PASS(Nms)
[IndexCombiner]  AppendJsonDocument_TwoValidJsons_ProducesCombinedJson  PASS(Nms)
Ran 2 tests with 0 failures in N seconds
END

expect TOCCOMBINER extra <<'END'
[TocCombiner]  TryGetJsonDocFromString_ValidString_ReturnsTrue             PASS(Nms)
[TocCombiner]  AppendJsonDocument_OneValueJson_ProducesThatJson            PASS(Nms)
[TocCombiner]  AppendJsonDocument_TrivialAndSimpleJson_ProducesSimpleJson  PASS(Nms)
Ran 3 tests with 0 failures in N seconds
END

expect .trivial --Automated <<'END'
##qzm:{"type":"TestStatus","version":2,"phase":"Begin","time":N,"processId":N,"name":"TocCombiner.AppendJsonDocument_TrivialAndSimpleJson_ProducesSimpleJson","state":0}
##qzm:{"type":"TestStatus","version":2,"phase":"End","time":N,"processId":N,"name":"TocCombiner.AppendJsonDocument_TrivialAndSimpleJson_ProducesSimpleJson","state":4,"message":"","fileName":"./Tools/DocTools/VantorPagemeld/TocCombinerTests","lineNumber":57,"durationMicroseconds":N,"duration":N}
END

expect "no such test" <<'END'
Ran 0 tests with 0 failures in N seconds
END

# The switch stands in the filter's place here, and so is the filter too.
expect -automated </dev/null
