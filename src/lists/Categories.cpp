#include "Categories.h"

#include "QmError.h"

clsCategory& colCategory::Add(const std::string& Key, const std::string& Description)
{
    entries_.push_back({Key, Description});
    return entries_.back();
}

const clsCategory& colCategory::Item(std::size_t position) const
{
    if (position < 1 || position > entries_.size())
        throw QmError(ErrorNumber::SubscriptOutOfRange, "Subscript out of range");
    return entries_[position - 1];
}
