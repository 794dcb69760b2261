#!/usr/bin/env bash
# SPDX-License-Identifier: MIT
# check-window-identity.sh PROGRAM DESKTOP_FILE: the window tells the desktop which entry is
# its own, so that docks show the entry's icon and can pin it: on Wayland its app id is the
# entry's id, on X11 its WM_CLASS is the entry's StartupWMClass. Runs PROGRAM under a headless
# Weston and under Xvfb, each until its window is seen or 30 seconds have passed.
set -euo pipefail
program="$1"
desktop="$2"
id="$(basename "$desktop" .desktop)"
wm_class="$(sed -n 's/^StartupWMClass=//p' "$desktop")"
[ -n "$wm_class" ] || { echo "no StartupWMClass in $desktop"; exit 1; }
scratch="$(mktemp -d)"
trap 'rm -rf "$scratch"' EXIT
chmod 700 "$scratch"
mkdir "$scratch/home"

# until_seen LOG PATTERN COMMAND...: runs COMMAND, its output to LOG, until LOG matches PATTERN.
until_seen() {
    local log="$1" pattern="$2"
    shift 2
    timeout 30 "$@" >"$log" 2>&1 &
    local started=$!
    for _ in $(seq 300); do
        grep -q "$pattern" "$log" && break
        sleep 0.1
    done
    kill "$started" 2>/dev/null || true
    wait "$started" 2>/dev/null || true
}

# Wayland: the app id the window sends, as the client's protocol log shows it.
XDG_RUNTIME_DIR="$scratch" timeout 60 weston --backend=headless-backend.so --socket=quillmark-test \
    --idle-time=0 >"$scratch/weston.log" 2>&1 &
weston=$!
for _ in $(seq 100); do [ -S "$scratch/quillmark-test" ] && break; sleep 0.1; done
HOME="$scratch/home" XDG_RUNTIME_DIR="$scratch" WAYLAND_DISPLAY=quillmark-test QT_QPA_PLATFORM=wayland \
    WAYLAND_DEBUG=1 until_seen "$scratch/wayland.log" 'set_app_id(' "$program"
kill "$weston" 2>/dev/null || true
wait "$weston" 2>/dev/null || true
app_id="$(sed -n 's/.*xdg_toplevel@[0-9]*\.set_app_id("\(.*\)")$/\1/p' "$scratch/wayland.log" | head -n 1)"
[ "$app_id" = "$id" ] || { echo "Wayland app id '$app_id', desktop entry '$id'"; tail -n 20 "$scratch/weston.log"; exit 1; }

# X11: the class of the window named after the program, as the window tree lists it.
HOME="$scratch/home" QT_QPA_PLATFORM=xcb until_seen "$scratch/x11.log" '"Quillmark[^"]*": ("[^"]*" "' xvfb-run -a sh -c '
    "$1" &
    while sleep 0.1; do xwininfo -root -tree; done' sh "$program"
class="$(sed -n 's/.*"Quillmark[^"]*": ("[^"]*" "\([^"]*\)").*/\1/p' "$scratch/x11.log" | head -n 1)"
[ "$class" = "$wm_class" ] || { echo "X11 WM_CLASS '$class', StartupWMClass '$wm_class'"; tail -n 20 "$scratch/x11.log"; exit 1; }
echo "the window names its desktop entry"
