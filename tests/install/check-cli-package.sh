#!/usr/bin/env bash
# SPDX-License-Identifier: MIT
# check-cli-package.sh DEB: the command-line package installs on a machine without a desktop:
# neither its dependencies nor its program name a Qt GUI library or another graphical one.
set -euo pipefail
deb="$1"
gui='libqt6(gui|widgets|opengl|dbus|xcb|wayland)|libgl|libegl|libx11|libxcb|libwayland|libfontconfig|libfreetype'
depends="$(dpkg-deb --field "$deb" Depends)"
if grep -Eiq "$gui" <<<"$depends"; then
    echo "$deb depends on a graphical library: $depends"
    exit 1
fi
scratch="$(mktemp -d)"
trap 'rm -rf "$scratch"' EXIT
dpkg-deb --extract "$deb" "$scratch"
needed="$(readelf --dynamic "$scratch/usr/bin/quillmark-cli" | sed -n 's/.*Shared library: \[\(.*\)\]/\1/p')"
if grep -Eiq "$gui" <<<"$needed"; then
    echo "quillmark-cli links a graphical library:" $needed
    exit 1
fi
grep -q '^libQt6Core' <<<"$needed"
echo "quillmark-cli needs: $(tr '\n' ' ' <<<"$needed")"
