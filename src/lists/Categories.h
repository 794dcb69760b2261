// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

// One category entry: its text is Description; Key is carried along but never read.
struct clsCategory {
    std::string Key;
    std::string Description;
};

// The ordered collection of categories, in the order of the list file.
class colCategory {
public:
    clsCategory& Add(const std::string& Key, const std::string& Description);

    auto begin() const { return entries_.begin(); }
    auto end() const { return entries_.end(); }

private:
    std::vector<clsCategory> entries_;
};
