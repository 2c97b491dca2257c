# Sourced by the scripts beside it: goes to the top of the tree, and gives them the steps they share.
# shellcheck shell=bash
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."

# Announces a step.
heading()
{
    printf '\n== %s\n' "$1"
}

# Runs a command; what it prints is shown only if it fails, with its exit status handed on.
quietly()
{
    local output status=0
    output=$("$@" 2>&1) || status=$?
    [ "$status" -eq 0 ] || printf '%s\n%s failed with exit status %s\n' "$output" "$*" "$status" >&2
    return "$status"
}

# Installs what is missing of groups of packages.
set_up()
{
    heading "Set-up: $*"
    script/setup "$@"
}

# Builds a preset.
build()
{
    heading "Build: $1"
    quietly cmake --preset "$1"
    quietly cmake --build --preset "$1"
}

# Builds the two programs by themselves, without the tools that the tests need.
build_programs()
{
    heading "Build: the programs"
    quietly cmake --preset release -D PAGEMELD_TESTS=AUTO
    quietly cmake --build --preset release --target pagemeld pagemeld-check
}
