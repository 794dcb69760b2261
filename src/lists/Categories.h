#pragma once

#include <cstddef>
#include <string>
#include <vector>

// One category entry: its text is Description; Key is carried along but never read.
struct clsCategory {
    std::string Key;
    std::string Description;
};

// The ordered collection of categories, numbered from 1. An entry may also be filed under a key.
class colCategory {
public:
    clsCategory& Add(const std::string& Key, const std::string& Description, const std::string& sKey = {});
    // Throws QmError 9 when there is no such entry.
    const clsCategory& Item(std::size_t position) const;
    const clsCategory& Item(const std::string& key) const;
    std::size_t Count() const { return entries_.size(); }
    void Remove(std::size_t position);
    void Remove(const std::string& key);

    auto begin() const { return entries_.begin(); }
    auto end() const { return entries_.end(); }

private:
    std::size_t positionOfKey(const std::string& key) const;

    std::vector<clsCategory> entries_;
    std::vector<std::string> keys_; // beside each entry: its key, or "" when it has none
};
