#pragma once

#include <boost/optional/optional.hpp>

#include "lut/io/ShaperEntries.h"
#include "lut/io/interchange/TextInterchange.h"

namespace Orlith::LUT {

/// What other programs' .cube and .itx files are, beside their book.
///
///   DOMAIN_MIN 0 0 0            the domain, each channel's own
///   DOMAIN_MAX 1 1 1
///   LUT_1D_SIZE 3               with a lattice size as well: a 1D block stands before the lattice
///   LUT_1D_INPUT_RANGE 0 1        and is its shaper, with a range of its own
///   LUT_3D_SIZE 2
///   LUT_3D_INPUT_RANGE 0 1
///   WORDS ...                   anything else that begins with a letter means nothing
class CubeInterchange final : public TextInterchange {
public:
    using TextInterchange::TextInterchange;

    bool wantsPlainTriples() const override;

    /// Looks at the table that the reader has made.
    /// @throws Exception  it is not what the file says
    void finish(LUT& lut, LineSource& lines);

protected:
    const char* dataError() const override;
    bool takeKeyword(std::string_view line) override;
    bool takeNumbers(std::string_view line) override;
    void watch(std::string_view line) override;
    std::string reasonOf(std::string_view message, std::string_view lastLine) override;

private:
    template <class Statement>
    void take(boost::optional<Statement>& statement, std::string_view keyword,
              const Statement& stated);

    int curveSize_ = 0;  // of the latest size lines; 0: none
    int latticeSize_ = 0;
    boost::optional<RGB> domainMin_;
    boost::optional<RGB> domainMax_;
    boost::optional<Range> curveRange_;
    boost::optional<Range> latticeRange_;
    ShaperEntries shaper_;  // the 1D block before a lattice
};

}  // namespace Orlith::LUT
