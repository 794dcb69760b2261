// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <fcntl.h>
#include <string>
#include <vector>

#include "FileDescriptor.h"
#include "SameBytes.h"
#include "TempDir.h"

namespace {

TEST(SameBytes, FileHoldsExactlyThePiecesOrNot)
{
    TempDir dir;
    // Larger than one read, so that a difference far in is found too.
    const std::string body(700000, 'b');
    const auto path = dir.write("a.dat", "0 head\r\n" + body + "\r\n");
    const FileDescriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC));
    const auto holds = [&file](std::vector<std::string_view> pieces) { return FileHoldsExactly(file.get(), pieces); };
    EXPECT_TRUE(holds({"0 head\r\n", body, "\r\n"}));
    EXPECT_TRUE(holds({"", "0 head\r", "\n" + body + "\r\n"}));
    auto changed = body;
    changed[650000] = 'c';
    EXPECT_FALSE(holds({"0 head\r\n", changed, "\r\n"})) << "same size, one byte differs";
    EXPECT_FALSE(holds({"0 head\r\n", body})) << "shorter";
    EXPECT_FALSE(holds({"0 head\r\n", body, "\r\n\r\n"})) << "longer";
    EXPECT_FALSE(FileHoldsExactly(-1, std::vector<std::string_view>{}));
}

} // namespace
