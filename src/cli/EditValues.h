// SPDX-License-Identifier: MIT
#pragma once

#include <ostream>

#include "HeaderEdits.h"

// The forms of edit's values, checked before any file is read, so that no value can end a header
// line early or add one of its own: valid UTF-8 text, no control character in any value (a TAB only in keywords and
// history texts, which keep it as it stands), the update tag as YYYY-RR, and user names (--as,
// the one in brackets of --author) in the characters the Parts Tracker allows in them. Says on
// err what is wrong, naming the option and the character by its code.
bool EditValuesValid(const HeaderEdits& edits, std::ostream& err);
