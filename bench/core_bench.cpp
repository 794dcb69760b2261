// SPDX-License-Identifier: MIT
// The line reader, the parser and the composer alone, on the generated part file.
#include <benchmark/benchmark.h>

#include "Composer.h"
#include "GeneratedPart.h"
#include "LineReader.h"
#include "ParseProgress.h"
#include "Parser.h"

namespace {

const std::string& partText(std::size_t lines)
{
    static const std::string small = GeneratePartFile(100000);
    static const std::string big = GeneratePartFile(1000000);
    return lines == 100000 ? small : big;
}

void LineReaderBench(benchmark::State& state)
{
    const auto& text = partText(static_cast<std::size_t>(state.range(0)));
    for (auto _ : state) {
        LineReader reader(text);
        std::size_t lines = 0;
        while (!reader.atEnd()) {
            benchmark::DoNotOptimize(reader.nextLine());
            ++lines;
        }
        benchmark::DoNotOptimize(lines);
    }
    state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * text.size()));
}

void ParserBench(benchmark::State& state)
{
    const auto& text = partText(static_cast<std::size_t>(state.range(0)));
    ParseProgress progress;
    for (auto _ : state) {
        HeaderData header;
        ParseHeaderText(header, text, progress);
        benchmark::DoNotOptimize(header.Body.size());
    }
    state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * text.size()));
}

void ComposerBench(benchmark::State& state)
{
    HeaderData header;
    ParseProgress progress;
    ParseHeaderText(header, partText(100000), progress);
    header.AuthorRealName = header.ParsedRealName;
    for (auto _ : state)
        benchmark::DoNotOptimize(ComposeHeader(header));
}

} // namespace

BENCHMARK(LineReaderBench)->Arg(100000)->Arg(1000000)->Unit(benchmark::kMillisecond);
BENCHMARK(ParserBench)->Arg(100000)->Arg(1000000)->Unit(benchmark::kMillisecond);
BENCHMARK(ComposerBench)->Unit(benchmark::kMicrosecond);
BENCHMARK_MAIN();
