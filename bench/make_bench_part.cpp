// Writes the generated part file of the benchmarks: make_bench_part LINES FILE
#include <cstdlib>
#include <fstream>
#include <iostream>

#include "GeneratedPart.h"

int main(int argc, char** argv)
{
    if (argc != 3) {
        std::cerr << "usage: make_bench_part LINES FILE\n";
        return 2;
    }
    const auto text = GeneratePartFile(std::strtoull(argv[1], nullptr, 10));
    std::ofstream(argv[2], std::ios::binary).write(text.data(), static_cast<std::streamsize>(text.size()));
    return 0;
}
