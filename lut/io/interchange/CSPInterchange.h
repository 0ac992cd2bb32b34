#pragma once

#include <cstddef>
#include <string>

#include "lut/io/interchange/TextInterchange.h"

namespace Orlith::LUT {

/// What other programs' .csp files are, beside their book.
///
///   BEGIN METADATA     up to END METADATA anything may stand, a backslash at the end included
///   0 0.25 \           elsewhere a backslash at the end of a line joins the next one to it, as
///   0.5 1                often as there is one
///   # comment          also between the samples, as are blank lines
///
/// The shapers of a curve count: whoever evaluates the table sends its colours through them.
class CSPInterchange final : public TextInterchange {
public:
    using TextInterchange::TextInterchange;

    bool wantsPlainTriples() const override { return stage_ != Stage::Samples || !begin_.empty(); }

    /// Looks at the shapers that the reader has just read.
    /// @throws Exception  as meant: they do not rise, or have too few points
    void takeShapers(const LUT& lut);

protected:
    const char* dataError() const override;
    bool isWhole(std::string_view& line) override;
    bool isVerbatim(std::string_view line) override;
    bool takeKeyword(std::string_view line) override;
    bool takeNumbers(std::string_view line) override;
    void watch(std::string_view line) override;
    std::string reasonOf(std::string_view message, std::string_view lastLine) override;

private:
    enum class Stage { Shapers, Size, Samples };  // what the next line belongs to

    void expectSize(std::string_view line);

    Stage stage_ = Stage::Shapers;  // all above them included
    bool hasKind_ = false;          // 1D or 3D
    bool isLattice_ = false;
    bool hasNumbers_ = false;
    bool isMetadata_ = false;
    std::size_t wordCount_ = 0;  // of the last line above the size
    std::string begin_;          // that the next line is joined to
    std::string whole_;
};

}  // namespace Orlith::LUT
