#pragma once

#include <string>

// The whole file as bytes, read at once. Throws QmError with the classic number on failure.
std::string ReadWholeFile(const std::string& path);
