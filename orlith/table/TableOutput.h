#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <functional>
#include <string>
#include <vector>

#include "lut/io/LUTFileWriter.h"
#include "lut/io/interchange/Fitting.h"
#include "orlith/OutputFile.h"
#include "orlith/table/TableFile.h"
#include "orlith/table/WriteOptions.h"

namespace CLI {
class App;
}  // namespace CLI

namespace orlith {

/// The table file that a command is asked for.
struct TableOutputOptions {
    std::string path;  ///< "-": standard output
    std::string to;    ///< extension with its dot; empty: the name's own
    WriteOptions writing;
    bool skipsVerification = false;
    bool isQuiet = false;
};

/// Adds OUT_LUT, --to, the writing options, --no-verify and --quiet.
void addTableOutputOptions(CLI::App& command, TableOutputOptions& options);

/// What a table was made of, for the summary.
struct Origin {
    /// The table whose look the file should have.
    boost::shared_ptr<Orlith::LUT::LUT> table;
    /// Why the file's look may be another, or what else is to be known.
    std::vector<std::string> causes;
    /// Further words on the table that was read back as other programs do; may be empty.
    std::function<std::string(const boost::shared_ptr<Orlith::LUT::LUT>& written)> judge;
};

/// Writes a table in the format that was asked for and proves that the file has its look.
class TableOutput {
public:
    /// @param options   outlive this
    /// @param isStrict  written and compared by the book alone: samples and pre-LUT
    /// @throws Failure     no such format
    /// @throws UsageError  options that the format does not take
    TableOutput(const TableOutputOptions& options, bool isStrict);

    const std::string& extension() const { return extension_; }

    /// As fit() does for the format.
    /// @throws Failure  no table of that size, with the file's name
    Orlith::LUT::Fitted fit(const boost::shared_ptr<Orlith::LUT::LUT>& lut, int size) const;

    /// Writes the table, reads it back, compares, puts the file in place and says so.
    /// @param fitted  its table gets the pre-LUT that was asked for
    /// @throws Failure, Cancelled  and what stood there before still does
    void write(OutputFile& output, const Orlith::LUT::Fitted& fitted, const Origin& origin) const;

private:
    void writeTable(const OutputFile& output, const boost::shared_ptr<Orlith::LUT::LUT>& lut) const;
    Table readBack(const OutputFile& output) const;
    std::string compareLooks(const OutputFile& output, const Orlith::LUT::Fitted& fitted,
                             const Origin& origin, const std::string& clipping) const;

    const TableOutputOptions& options_;
    const bool isStrict_;
    const bool isByBook_;  // how the file is written
    const std::string extension_;
    const Options3DL options3DL_;
    boost::shared_ptr<Orlith::LUT::LUTFileWriter> writer_;
};

}  // namespace orlith
