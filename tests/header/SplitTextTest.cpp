#include <gtest/gtest.h>

#include "SplitText.h"

namespace {

using Pieces = std::vector<std::string>;

TEST(SplitText, PiecesBetweenSeparators)
{
    EXPECT_EQ(SplitText("a/b//c/", "/"), (Pieces{"a", "b", "", "c", ""}));
    EXPECT_EQ(SplitText("", "/"), Pieces{});
    EXPECT_EQ(SplitText("abc", ""), (Pieces{"abc"}));
    EXPECT_EQ(SplitText("a/b/c", "/", 0), Pieces{});
    EXPECT_EQ(SplitText("a/b/c", "/", 1), (Pieces{"a/b/c"}));
    EXPECT_EQ(SplitText("a/b/c", "/", 2), (Pieces{"a", "b/c"}));
    EXPECT_EQ(SplitText("aXbxc", "x", -1, CompareMode::IgnoreCase), (Pieces{"a", "b", "c"}));
    EXPECT_EQ(SplitText("a\r\nb\r\n", "\r\n"), (Pieces{"a", "b", ""}));
}

} // namespace
