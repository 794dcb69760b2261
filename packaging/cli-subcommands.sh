#!/usr/bin/env bash
# SPDX-License-Identifier: MIT
# Writes the SUBCOMMANDS section of quillmark-cli's man page, as help2man includes it, from the
# --help of the program and of each of its subcommands, so that the page lists every option.
set -euo pipefail
cli="$1"

echo "[SUBCOMMANDS]"
for subcommand in $("$cli" --help | sed -n '/^Subcommands:/,$s/^  \([a-z][a-z-]*\) .*/\1/p'); do
    "$cli" "$subcommand" --help | awk '
        # Text as roff shows it literally: backslashes, minus signs, a leading dot or quote.
        function roff(text) {
            gsub(/\\/, "\\e", text); gsub(/-/, "\\-", text); sub(/^[.\047]/, "\\\\&&", text)
            return text
        }
        /^Usage: / { sub(/^Usage: /, ""); printf ".SS \"%s\"\n%s\n", roff($0), roff(about); next }
        /^Positionals:$/ { positional = 1; next }
        /^Options:$/ { positional = 0; next }
        /^  [^ ]/ {
            item = $0; sub(/^  /, "", item); text = item
            sub(/  +.*$/, "", item); sub(/^[^ ]+( [^ ]+)*  +/, "", text)
            if (item == "-h,--help") next
            # A positional reads "FILE TEXT ... REQUIRED": its name, and whether it repeats.
            if (positional) item = (item ~ / \.\.\. /) ? $1 "..." : $1
            printf ".TP\n\\fB%s\\fR\n%s\n", roff(item), roff(text); next
        }
        NF > 0 { about = (about == "" ? $0 : about " " $0) }
    '
done
