#pragma once

#include <string>
#include <string_view>
#include <vector>

// The words of a header line: split at every blank, so two blanks in a row give an empty word
// between them, a leading blank gives an empty first word, and one blank at the very end gives
// no empty last word. Index 0 holds word 1. The views point into line.
void SplitWords(std::string_view line, std::vector<std::string_view>& words);

// The words from the 1-based position k joined by single blanks; empty words before the first
// non-empty one are skipped, later empty words keep their blank.
std::string JoinWordsFrom(const std::vector<std::string_view>& words, std::size_t k);
