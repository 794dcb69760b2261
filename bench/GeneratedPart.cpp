// SPDX-License-Identifier: MIT
#include "GeneratedPart.h"

#include <cstdint>

namespace {

const char* const Header[] = {
    "0 Brick 2 x 4 with Benchmark Pattern",
    "0 Name: bench.dat",
    "0 Author: Sam Sample [ssample]",
    "0 !LDRAW_ORG Part UPDATE 2024-01",
    "0 !LICENSE Licensed under CC BY 4.0 : see CAreadme.txt",
    "",
    "0 BFC CERTIFY CCW",
    "",
    "0 !CATEGORY Brick",
    "0 !KEYWORDS benchmark, generated, pattern",
    "",
    "0 !HISTORY 2024-01-01 [ssample] Generated for measuring",
    "0 // Made by the benchmark, not a real part",
    "",
};

// A small linear congruential generator: the same numbers on every machine.
class Numbers {
public:
    int next(int range)
    {
        state_ = state_ * 6364136223846793005ULL + 1442695040888963407ULL;
        return static_cast<int>((state_ >> 33) % static_cast<std::uint64_t>(range)) - range / 2;
    }

private:
    std::uint64_t state_ = 20241206;
};

void appendNumbers(std::string& line, Numbers& numbers, int count)
{
    for (int i = 0; i < count; ++i) {
        line += ' ';
        line += std::to_string(numbers.next(2000));
    }
}

std::string geometryLine(std::size_t index, Numbers& numbers)
{
    const int type = static_cast<int>(index % 5) + 1;
    std::string line = std::to_string(type) + " 16";
    switch (type) {
    case 1:
        appendNumbers(line, numbers, 12);
        line += " stud.dat";
        break;
    case 2: appendNumbers(line, numbers, 6); break;
    case 3: appendNumbers(line, numbers, 9); break;
    case 4: appendNumbers(line, numbers, 12); break;
    default: appendNumbers(line, numbers, 12); break;
    }
    return line;
}

} // namespace

std::string GeneratePartFile(std::size_t lineCount)
{
    std::string text;
    text.reserve(lineCount * 50);
    Numbers numbers;
    std::size_t written = 0;
    for (const char* line : Header) {
        if (written == lineCount)
            return text;
        text.append(line).append("\r\n");
        ++written;
    }
    for (; written < lineCount; ++written)
        text.append(geometryLine(written, numbers)).append("\r\n");
    return text;
}
