#include "Words.h"

void SplitWords(std::string_view line, std::vector<std::string_view>& words)
{
    words.clear();
    std::string_view rest = line;
    while (!rest.empty()) {
        const auto blank = rest.find(' ');
        if (blank == std::string_view::npos) {
            words.push_back(rest);
            break;
        }
        words.push_back(rest.substr(0, blank));
        rest.remove_prefix(blank + 1);
    }
}

std::string JoinWordsFrom(const std::vector<std::string_view>& words, std::size_t k)
{
    std::string result;
    for (std::size_t position = k; position <= words.size(); ++position) {
        const auto word = words[position - 1];
        if (!result.empty())
            result += ' ';
        result += word;
    }
    return result;
}
