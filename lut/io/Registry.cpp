#include "lut/io/Registry.h"

#include <boost/smart_ptr/make_shared.hpp>
#include <string_view>
#include <utility>

#include "lut/Exception.h"
#include "lut/io/LUTFileReader3DL.h"
#include "lut/io/LUTFileReaderBLUT.h"
#include "lut/io/LUTFileReaderCMS.h"
#include "lut/io/LUTFileReaderCSP.h"
#include "lut/io/LUTFileReaderIridas.h"
#include "lut/io/LUTFileReaderTruelight.h"
#include "lut/io/LUTFileReaderVF.h"
#include "lut/io/LUTFileWriter3DL.h"
#include "lut/io/LUTFileWriterBLUT.h"
#include "lut/io/LUTFileWriterCMS.h"
#include "lut/io/LUTFileWriterCSP.h"
#include "lut/io/LUTFileWriterIridas.h"
#include "lut/io/LUTFileWriterTruelight.h"
#include "lut/io/LUTFileWriterVF.h"

namespace Orlith::LUT {
namespace {

/// One extension: how to make its reader or writer, or the text that refuses it.
template <class Face>
struct Row {
    std::string_view extension;
    boost::shared_ptr<Face> (*make)();
    const char* refusal;
};

template <class Face, class Format>
boost::shared_ptr<Face> make() {
    return boost::make_shared<Format>();
}

template <class Format>
constexpr Row<LUTFileReader> reads(std::string_view extension) {
    return {extension, make<LUTFileReader, Format>, nullptr};
}

template <class Format>
constexpr Row<LUTFileWriter> writes(std::string_view extension) {
    return {extension, make<LUTFileWriter, Format>, nullptr};
}

// Tested from the top; the first match decides. One row a line.
// clang-format off
constexpr Row<LUTFileReader> kReaders[] = {
    reads<LUTFileReaderIridas>(".cube"),
    reads<LUTFileReaderIridas>(".itx"),
    reads<LUTFileReaderTruelight>(".cub"),
    reads<LUTFileReader3DL>(".3dl"),
    reads<LUTFileReaderVF>(".vf"),
    reads<LUTFileReaderVF>(".gz"),
    reads<LUTFileReaderVF>(".vfz"),
    reads<LUTFileReaderCSP>(".csp"),
    reads<LUTFileReaderCMS>(".cms"),
    {".icc", nullptr, "reader not found"},
    reads<LUTFileReaderBLUT>(".blut"),
};

constexpr Row<LUTFileWriter> kWriters[] = {
    writes<LUTFileWriterIridas>(".cube"),
    writes<LUTFileWriter3DL>(".3dl"),
    writes<LUTFileWriterVF>(".vf"),
    writes<LUTFileWriterVF>(".gz"),
    writes<LUTFileWriterVF>(".vfz"),
    writes<LUTFileWriterCSP>(".csp"),
    writes<LUTFileWriterTruelight>(".cub"),
    writes<LUTFileWriterCMS>(".cms"),
    {".icc", nullptr, "writer not found"},
    writes<LUTFileWriterBLUT>(".blut"),
};
// clang-format on

template <class Face, std::size_t kRowCount>
boost::shared_ptr<Face> create(const Row<Face> (&rows)[kRowCount], const std::string& filename,
                               bool useGivenExtension, const std::string& givenExtension,
                               const char* notFound) {
    std::string extension = givenExtension;
    if (!useGivenExtension) splitExtension(filename, nullptr, &extension);
    for (const Row<Face>& row : rows) {
        if (row.extension != extension) continue;
        if (row.refusal != nullptr) throw Exception(row.refusal);
        return row.make();
    }
    throw Exception(notFound);
}

}  // namespace

boost::shared_ptr<LUTFileReader> createReader(const std::string& filename, bool useGivenExtension,
                                              const std::string& givenExtension) {
    // Deliberate: the %s stays as it is, here and below; callers show the text unformatted.
    return create(kReaders, filename, useGivenExtension, givenExtension,
                  "No reader found for extension \"%s\".");
}

boost::shared_ptr<LUTFileWriter> createWriter(const std::string& filename, bool useGivenExtension,
                                              const std::string& givenExtension) {
    return create(kWriters, filename, useGivenExtension, givenExtension,
                  "No writer found for extension \"%s\".");
}

void splitExtension(const std::string& path, std::string* base, std::string* extension) {
    constexpr std::string_view kFolderEnds = "\\/:";
    std::size_t split = path.find_last_of(".\\/:");
    const bool startsExtension = split != std::string::npos && path[split] == '.' && split > 0 &&
                                 kFolderEnds.find(path[split - 1]) == std::string_view::npos;
    if (!startsExtension) split = path.size();
    std::string name = path.substr(0, split);  // both first: either may go where path is
    std::string suffix = path.substr(split);
    if (base != nullptr) *base = std::move(name);
    if (extension != nullptr) *extension = std::move(suffix);
}

}  // namespace Orlith::LUT
