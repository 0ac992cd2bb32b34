// Reading and writing a lattice in every format, each next to the plain way in the same run: a
// stream of the C++ library and its operators over the same numbers.

#include <benchmark/benchmark.h>
#include <zlib.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <cmath>
#include <cstdio>
#include <fstream>
#include <iomanip>
#include <vector>

#include "bench/Tables.h"
#include "lut/io/Registry.h"

namespace {

namespace ol = Orlith::LUT;
namespace property = Orlith::Property;

constexpr char kTextFormats[][6] = {".cube", ".3dl", ".cms", ".csp", ".cub", ".vf"};

bool isInteger(const std::string& extension) {
    return extension == ".3dl";
}

boost::shared_ptr<ol::LUTFileWriter> makeWriter(const std::string& extension, bool flushesLines) {
    auto writer = ol::createWriter("", true, extension);
    const auto set = [&](const char* name, auto value) { writer->setProperty(name, value); };
    set("flushLines", property::makeProperty<property::Int>("flushLines", flushesLines ? 1 : 0));
    set("inputBitDepth", property::makeProperty<property::Int>("inputBitDepth", 10));
    set("outputBitDepth", property::makeProperty<property::Int>("outputBitDepth", 12));
    set("clampOutput", property::makeProperty<property::Int>("clampOutput", 1));
    set("format3DL", property::makeProperty<property::String>("format3DL", "flame"));
    return writer;
}

boost::shared_ptr<ol::LUTFileReader> makeReader(const std::string& extension, bool isMeant) {
    auto reader = ol::createReader("", true, extension);
    const auto set = [&](const char* name, auto value) { reader->setProperty(name, value); };
    set("format3DL", property::makeProperty<property::String>("format3DL", "auto"));
    set("interchange", property::makeProperty<property::Int>("interchange", isMeant ? 1 : 0));
    set("outputBitDepth", property::makeProperty<property::Int>("outputBitDepth", -2));
    set("normalizeOutput", property::makeProperty<property::Int>("normalizeOutput", 0));
    return reader;
}

void countPoints(benchmark::State& state) {
    const auto points = state.range(0);
    state.SetItemsProcessed(state.iterations() * points * points * points);
}

// Writing

void write(benchmark::State& state, const std::string& extension, bool flushesLines) {
    const auto lut = bench::look(static_cast<int>(state.range(0)));
    const bench::ScratchFile file(extension);
    const auto writer = makeWriter(extension, flushesLines);
    for (auto _ : state)
        writer->write(file.path(), lut);
    countPoints(state);
}

template <class End>
void writePlain(benchmark::State& state, const std::string& extension, End endLine) {
    const auto lut = bench::look(static_cast<int>(state.range(0)));
    const bench::ScratchFile file(extension);
    const float* const samples = lut->data();
    const std::size_t floatCount = lut->dataSize() / sizeof(float);
    for (auto _ : state) {
        std::ofstream out(file.path());
        out << std::fixed << std::setprecision(6);
        for (std::size_t i = 0; i < floatCount; i += 3) {
            if (isInteger(extension)) {
                const auto code = [&](std::size_t c) {
                    return static_cast<int>(std::nearbyint(samples[i + c] * 4095.0F));
                };
                out << code(0) << ' ' << code(1) << ' ' << code(2);
            } else {
                out << samples[i] << ' ' << samples[i + 1] << ' ' << samples[i + 2];
            }
            endLine(out);
        }
    }
    countPoints(state);
}

void endFlushed(std::ostream& out) {
    out << std::endl;
}

void endGathered(std::ostream& out) {
    out << '\n';
}

void writeRaw(benchmark::State& state) {
    const auto lut = bench::look(static_cast<int>(state.range(0)));
    const bench::ScratchFile file(".raw");
    for (auto _ : state) {
        std::FILE* const out = std::fopen(file.path().c_str(), "wb");
        std::fwrite(lut->data(), 1, lut->dataSize(), out);
        std::fclose(out);
    }
    countPoints(state);
}

// Reading

void read(benchmark::State& state, const std::string& extension, bool isMeant) {
    const bench::ScratchFile file(extension);
    makeWriter(extension, false)->write(file.path(), bench::look(static_cast<int>(state.range(0))));
    const auto reader = makeReader(extension, isMeant);
    for (auto _ : state)
        benchmark::DoNotOptimize(reader->read(file.path()));
    countPoints(state);
}

/// A file of nothing but the numbers of a table.
void writeNumbers(const std::string& path, const std::string& extension, const ol::LUT& lut) {
    std::ofstream out(path);
    out << std::fixed << std::setprecision(6);
    const float* const samples = lut.data();
    for (std::size_t i = 0; i < lut.dataSize() / sizeof(float); ++i) {
        if (isInteger(extension)) {
            out << static_cast<int>(std::nearbyint(samples[i] * 4095.0F));
        } else {
            out << samples[i];
        }
        out << (i % 3 == 2 ? '\n' : ' ');
    }
}

void readPlain(benchmark::State& state, const std::string& extension) {
    const bench::ScratchFile file(".txt");
    writeNumbers(file.path(), extension, *bench::look(static_cast<int>(state.range(0))));
    for (auto _ : state) {
        std::ifstream in(file.path());
        double number = 0.0;
        double sum = 0.0;
        while (in >> number)
            sum += number;
        benchmark::DoNotOptimize(sum);
    }
    countPoints(state);
}

void readCompressed(benchmark::State& state) {
    const bench::ScratchFile plain(".vf");
    const bench::ScratchFile compressed(".vfz");
    makeWriter(".vf", false)->write(plain.path(), bench::look(static_cast<int>(state.range(0))));
    std::ifstream text(plain.path(), std::ios::binary);
    const std::vector<char> bytes{std::istreambuf_iterator<char>(text), {}};
    const gzFile out = gzopen(compressed.path().c_str(), "wb");
    gzwrite(out, bytes.data(), static_cast<unsigned>(bytes.size()));
    gzclose(out);
    const auto reader = makeReader(".vfz", false);
    for (auto _ : state)
        benchmark::DoNotOptimize(reader->read(compressed.path()));
    countPoints(state);
}

void readRaw(benchmark::State& state) {
    const auto lut = bench::look(static_cast<int>(state.range(0)));
    const bench::ScratchFile file(".raw");
    std::ofstream(file.path(), std::ios::binary)
        .write(reinterpret_cast<const char*>(lut->data()), lut->dataSize());
    for (auto _ : state) {
        std::FILE* const in = std::fopen(file.path().c_str(), "rb");
        benchmark::DoNotOptimize(std::fread(lut->data(), 1, lut->dataSize(), in));
        std::fclose(in);
    }
    countPoints(state);
}

template <class Function>
void add(const std::string& name, Function function) {
    benchmark::RegisterBenchmark(name.c_str(), function)
        ->Arg(33)
        ->Arg(65)
        ->Unit(benchmark::kMillisecond);
}

}  // namespace

int main(int argc, char** argv) {
    for (const std::string extension : kTextFormats) {
        using State = benchmark::State;
        add("write" + extension + "/lines", [=](State& s) { write(s, extension, true); });
        add("write" + extension + "/lines_plain",
            [=](State& s) { writePlain(s, extension, endFlushed); });
        add("write" + extension + "/blocks", [=](State& s) { write(s, extension, false); });
        add("write" + extension + "/blocks_plain",
            [=](State& s) { writePlain(s, extension, endGathered); });
        add("read" + extension, [=](State& s) { read(s, extension, false); });
        add("read" + extension + "/meant", [=](State& s) { read(s, extension, true); });
        add("read" + extension + "/plain", [=](State& s) { readPlain(s, extension); });
    }
    add("read.vfz", readCompressed);
    add("write.blut", [](benchmark::State& s) { write(s, ".blut", true); });
    add("write.blut/plain", writeRaw);
    add("read.blut", [](benchmark::State& s) { read(s, ".blut", false); });
    add("read.blut/plain", readRaw);

    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
