// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <string_view>

#include "HeaderData.h"

// Known faults in the body that saving offers to correct, each with its test.

// Looks in any letter case, but corrects the exact spelling only.
bool HasCertifyInvertNext(std::string_view body);
// "0 BFC CERTIFY INVERTNEXT" becomes "0 BFC INVERTNEXT".
void FixCertifyInvertNext(std::string& body);

// True exactly when the correction would change a line, so that a question answered once does
// not come back on the next save; the same for HasWriteLines.
bool HasRotationLines(std::string_view body);
// Removes the lines that begin with "0 ROTATION " in any letter case, and empty lines before the
// first kept one.
void DeleteRotationLines(std::string& body);

bool HasWriteLines(std::string_view body);
// A line that begins with the word "0 WRITE" in any letter case loses the word WRITE: "0 WRITE x"
// becomes "0 x". "WRITE" elsewhere in a line stays.
void RemoveWriteKeywords(std::string& body);

bool HasColorLines(const HeaderData& header);
void ClearColorLines(HeaderData& header);
