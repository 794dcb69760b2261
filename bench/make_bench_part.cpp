// SPDX-License-Identifier: MIT
// Writes the generated part files of the benchmarks:
//   make_bench_part LINES FILE          one part file
//   make_bench_part LINES FOLDER COUNT  COUNT part files in FOLDER, as a library folder holds them
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <string>

#include "GeneratedPart.h"

namespace {

void writeFile(const std::string& path, const std::string& text)
{
    std::ofstream(path, std::ios::binary).write(text.data(), static_cast<std::streamsize>(text.size()));
}

} // namespace

int main(int argc, char** argv)
{
    if (argc != 3 && argc != 4) {
        std::cerr << "usage: make_bench_part LINES FILE | make_bench_part LINES FOLDER COUNT\n";
        return 2;
    }
    const auto text = GeneratePartFile(std::strtoull(argv[1], nullptr, 10));
    if (argc == 3) {
        writeFile(argv[2], text);
        return 0;
    }
    const auto count = std::strtoull(argv[3], nullptr, 10);
    for (unsigned long long index = 0; index < count; ++index) {
        char name[32];
        std::snprintf(name, sizeof name, "/part%05llu.dat", index);
        writeFile(argv[2] + std::string(name), text);
    }
    return 0;
}
