#include "LineReader.h"

#include <cstring>

std::string_view LineReader::nextLine()
{
    const char* start = text_.data() + position_;
    const std::size_t rest = text_.size() - position_;
    const auto* cr = static_cast<const char*>(std::memchr(start, '\r', rest));
    if (cr == nullptr) {
        position_ = text_.size();
        return {start, rest};
    }
    const auto length = static_cast<std::size_t>(cr - start);
    position_ += length + 1;
    if (position_ < text_.size() && text_[position_] == '\n')
        ++position_;
    return {start, length};
}
