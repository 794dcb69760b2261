# SPDX-License-Identifier: MIT
# Shared by the scripts: install what is missing from Debian's packages, then configure and build.
# Sourced, not run.

QUILLMARK_ROOT="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"

# The packages every build needs; scripts add their own.
QUILLMARK_PACKAGES=(cmake ninja-build g++ qt6-base-dev qt6-tools-dev qt6-l10n-tools libcli11-dev nlohmann-json3-dev libtomlplusplus-dev libgtest-dev libgmock-dev
                    libgl-dev fonts-dejavu-core desktop-file-utils libxml2-utils appstream clang-format
                    shared-mime-info libglib2.0-bin xdg-utils weston qt6-wayland xvfb x11-utils)

# A package counts as present once installed, also while its triggers still wait to run.
# apt waits up to two minutes for the dpkg lock when another apt run holds it.
ensure_packages() {
    local missing=()
    local package
    for package in "$@"; do
        case "$(dpkg-query -W -f='${db:Status-Status}' "$package" 2>/dev/null)" in
            installed | triggers-pending | triggers-awaited) ;;
            *) missing+=("$package") ;;
        esac
    done
    [ ${#missing[@]} -eq 0 ] && return 0
    echo "Installing: ${missing[*]}" >&2
    local sudo=""
    [ "$(id -u)" -ne 0 ] && sudo="sudo"
    local apt=(apt-get -o DPkg::Lock::Timeout=120)
    $sudo "${apt[@]}" update -qq
    DEBIAN_FRONTEND=noninteractive $sudo "${apt[@]}" install -y -qq --no-install-recommends "${missing[@]}" >&2
}

# configure_and_build BUILD_DIR [cmake options...]
configure_and_build() {
    local build_dir="$1"
    shift
    cmake -S "$QUILLMARK_ROOT" -B "$build_dir" -G Ninja "$@" >&2
    cmake --build "$build_dir" >&2
}

# cpp_files [find actions...]: every C++ source and header of the project.
cpp_files() {
    find "$QUILLMARK_ROOT/src" "$QUILLMARK_ROOT/tests" "$QUILLMARK_ROOT/bench" "$QUILLMARK_ROOT/fuzz" \
        \( -name '*.cpp' -o -name '*.h' \) "$@"
}

# The licence of every source file, named in its first line (after a "#!" line).
LICENCE_ID="SPDX-License-Identifier: MIT"

# licensed_files: "MARK<tab>FILE" for every source file, MARK being its language's comment.
licensed_files() {
    cpp_files -printf '//\t%p\n'
    find "$QUILLMARK_ROOT/CMakeLists.txt" "$QUILLMARK_ROOT"/{src,tests,bench,fuzz,packaging,scripts,.ci} -type f \
        \( -name CMakeLists.txt -o -name '*.cmake' -o -name '*.sh' -o -perm -u+x \) -printf '#\t%p\n'
}

# unlicensed_files: the lines of licensed_files whose file lacks the licence line.
unlicensed_files() {
    local mark file first
    licensed_files | while IFS=$'\t' read -r mark file; do
        first="$(head -n 1 "$file")"
        [[ "$first" == '#!'* ]] && first="$(sed -n 2p "$file")"
        [ "$first" = "$mark $LICENCE_ID" ] || printf '%s\t%s\n' "$mark" "$file"
    done
}

# Fails with the files to format when any file is not formatted as .clang-format says, or
# lacks its licence line.
check_format() {
    local unformatted unlicensed
    unformatted=$(cpp_files -exec clang-format --dry-run --Werror {} + 2>&1 | grep -o '^[^:]*\.\(cpp\|h\)' | sort -u || true)
    unlicensed=$(unlicensed_files | cut -f 2)
    if [ -n "$unformatted" ] || [ -n "$unlicensed" ]; then
        echo "These files are not formatted or lack the line \"$LICENCE_ID\"; run scripts/format:" >&2
        printf '%s\n' $unformatted $unlicensed >&2
        return 1
    fi
}
