#pragma once

#include <string>
#include <string_view>

#include "HeaderData.h"

// Known faults in the body that saving offers to correct. The tests look for the text in any
// letter case; the corrections change the exact spelling only.

bool HasCertifyInvertNext(std::string_view body);
// "0 BFC CERTIFY INVERTNEXT" becomes "0 BFC INVERTNEXT".
void FixCertifyInvertNext(std::string& body);

bool HasRotationLines(std::string_view body);
// Removes the lines that begin with "0 ROTATION ", and empty lines before the first kept one.
void DeleteRotationLines(std::string& body);

bool HasWriteLines(std::string_view body);
// Every "0 WRITE" becomes "0", wherever it stands.
void RemoveWriteKeywords(std::string& body);

bool HasColorLines(const HeaderData& header);
void ClearColorLines(HeaderData& header);
