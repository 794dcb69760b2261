#!/usr/bin/env bash
# SPDX-License-Identifier: MIT
# check-translations.sh LUPDATE TS_FILE LUPDATE_ARGUMENTS...: runs lupdate over the window's
# sources into a copy of TS_FILE and fails when that changes the copy (a text is new or gone:
# run the build's update_translations target) or leaves an entry unfinished (translate it).
set -euo pipefail
lupdate="$1"
ts="$2"
shift 2
scratch="$(mktemp -d)"
trap 'rm -rf "$scratch"' EXIT
copy="$scratch/$(basename "$ts")"
cp "$ts" "$copy"
"$lupdate" "$@" -ts "$copy" >"$scratch/lupdate.log" 2>&1 || { cat "$scratch/lupdate.log"; exit 1; }
status=0
if ! diff -u "$ts" "$copy"; then
    echo "$ts is not up to date with the sources' texts: run the update_translations target"
    status=1
fi
if grep -B2 'type="unfinished"' "$copy"; then
    echo "$ts has texts without a translation"
    status=1
fi
[ "$status" -eq 0 ] && echo "$(grep -c '<source>' "$ts") texts, all translated"
exit "$status"
