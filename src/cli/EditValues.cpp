// SPDX-License-Identifier: MIT
#include "EditValues.h"

#include <algorithm>
#include <cstdio>

#include "ConsoleDialogs.h"
#include "Text.h"

namespace {

bool isControl(char c)
{
    const auto code = static_cast<unsigned char>(c);
    return code < 0x20 || code == 0x7F;
}

// The characters of the Parts Tracker's user names.
bool isUserNameCharacter(char c)
{
    return (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || c == '_' || c == '.' ||
           c == '-';
}

std::string codeOf(char c)
{
    char text[8];
    std::snprintf(text, sizeof text, "0x%02X", static_cast<unsigned char>(c));
    return text;
}

// Bytes as ASCII, every other one as "\x" and two hex digits: a value that is not UTF-8 shown as
// it is.
std::string bytesEscaped(std::string_view value)
{
    std::string shown;
    for (const char c : value)
        shown += static_cast<unsigned char>(c) < 0x80 ? std::string(1, c) : "\\x" + codeOf(c).substr(2);
    return shown;
}

class ValueCheck {
public:
    explicit ValueCheck(std::ostream& err) : err_(err) {}
    bool ok() const { return ok_; }

    void noControlsIn(const char* option, std::string_view value, bool tabAllowed)
    {
        // A value is text: bytes of another encoding would give the file two.
        if (!IsValidUtf8(value)) {
            refuse(option, bytesEscaped(value), "is not valid UTF-8 text");
            return;
        }
        const auto bad = std::find_if(value.begin(), value.end(),
                                      [tabAllowed](char c) { return isControl(c) && !(tabAllowed && c == '\t'); });
        if (bad != value.end())
            refuse(option, value, "holds the control character " + codeOf(*bad) + ", which no header line can hold");
    }
    void noControls(const char* option, const std::optional<std::string>& value, bool tabAllowed = false)
    {
        if (value)
            noControlsIn(option, *value, tabAllowed);
    }
    void noControls(const char* option, const StringList& values)
    {
        for (const auto& value : values)
            noControlsIn(option, value, true);
    }

    void userName(const char* option, std::string_view user)
    {
        const auto bad = std::find_if_not(user.begin(), user.end(), isUserNameCharacter);
        if (bad != user.end())
            refuse(option, user,
                   "names a user with the character " + codeOf(*bad) +
                       "; a user name has letters, digits, \"_\", \".\" and \"-\" only");
    }

    void updateTag(const std::optional<std::string>& tag)
    {
        const auto digitsAt = [&tag](std::size_t from, std::size_t to) {
            return std::all_of(tag->begin() + static_cast<long>(from), tag->begin() + static_cast<long>(to),
                               [](char c) { return c >= '0' && c <= '9'; });
        };
        if (tag && !(tag->size() == 7 && (*tag)[4] == '-' && digitsAt(0, 4) && digitsAt(5, 7)))
            refuse("--update", *tag, "is not YYYY-RR (year and release, such as 2024-01)");
    }

private:
    void refuse(const char* option, std::string_view value, const std::string& why)
    {
        err_ << "quillmark-cli: " << option << " \"" << ShownText(value) << "\" " << why << '\n';
        ok_ = false;
    }

    std::ostream& err_;
    bool ok_ = true;
};

// The user in the brackets that end "Real Name [user]", if any.
std::optional<std::string_view> bracketedUser(std::string_view author)
{
    const auto open = author.rfind('[');
    const auto close = author.find_last_not_of(' ');
    if (open == std::string_view::npos || close == std::string_view::npos || author[close] != ']' || close < open)
        return std::nullopt;
    return author.substr(open + 1, close - open - 1);
}

} // namespace

bool EditValuesValid(const HeaderEdits& edits, std::ostream& err)
{
    ValueCheck check(err);
    check.noControls("--description", edits.description);
    check.noControls("--author", edits.author);
    check.noControls("--type", edits.type);
    check.noControls("--update", edits.update);
    check.noControls("--license", edits.license);
    check.noControls("--bfc", edits.bfc);
    check.noControls("--category", edits.category);
    check.noControls("--add-keywords", edits.addKeywords);
    check.noControls("--remove-keywords", edits.removeKeywords);
    check.noControls("--add-history", edits.addHistory, true);
    if (!check.ok())
        return false;
    check.updateTag(edits.update);
    if (edits.author)
        if (const auto user = bracketedUser(*edits.author))
            check.userName("--author", *user);
    if (edits.addHistory)
        check.userName("--as", edits.historyUser);
    return check.ok();
}
