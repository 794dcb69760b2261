#include "Categories.h"

#include "QmError.h"

namespace {

QmError noSuchEntry() { return {ErrorNumber::SubscriptOutOfRange, "Subscript out of range"}; }

} // namespace

clsCategory& colCategory::Add(const std::string& Key, const std::string& Description, const std::string& sKey)
{
    entries_.push_back({Key, Description});
    keys_.push_back(sKey);
    return entries_.back();
}

const clsCategory& colCategory::Item(std::size_t position) const
{
    if (position < 1 || position > entries_.size())
        throw noSuchEntry();
    return entries_[position - 1];
}

const clsCategory& colCategory::Item(const std::string& key) const { return Item(positionOfKey(key)); }

void colCategory::Remove(std::size_t position)
{
    if (position < 1 || position > entries_.size())
        throw noSuchEntry();
    entries_.erase(entries_.begin() + static_cast<std::ptrdiff_t>(position - 1));
    keys_.erase(keys_.begin() + static_cast<std::ptrdiff_t>(position - 1));
}

void colCategory::Remove(const std::string& key) { Remove(positionOfKey(key)); }

std::size_t colCategory::positionOfKey(const std::string& key) const
{
    for (std::size_t i = 0; i < keys_.size(); ++i)
        if (!key.empty() && keys_[i] == key)
            return i + 1;
    throw noSuchEntry();
}
