#pragma once

#include <cstddef>
#include <string>
#include <vector>

// One category entry: its text is Description; Key is carried along but never read.
struct clsCategory {
    std::string Key;
    std::string Description;
};

// The ordered collection of categories, numbered from 1.
class colCategory {
public:
    clsCategory& Add(const std::string& Key, const std::string& Description);
    // Throws QmError 9 when there is no such entry.
    const clsCategory& Item(std::size_t position) const;
    std::size_t Count() const { return entries_.size(); }

    auto begin() const { return entries_.begin(); }
    auto end() const { return entries_.end(); }

private:
    std::vector<clsCategory> entries_;
};
