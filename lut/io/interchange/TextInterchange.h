#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "lut/Exception.h"
#include "lut/LUT.h"
#include "lut/evaluation/Range.h"
#include "lut/io/LUTFileReader.h"
#include "lut/io/text/LineSource.h"

namespace Orlith::LUT {

/// What other programs' files of a text format are, beside its book.
///
/// Stands between the lines of a file and a reader that goes by the book. By the book it only
/// watches, and remarks what changes colours and is not used. As meant it
/// - takes a byte order mark, carriage returns, blank lines and comments away, and trims;
/// - makes points of decimal commas, and refuses a word that is not wholly a finite number;
/// - has each format's own class deal with the words that the book does not know;
/// - looks at the finished table: its domain, its shapers, the number of its samples.
/// In both modes a failure leaves its reason in words as the last remark.
class TextInterchange : public LineFilter {
public:
    explicit TextInterchange(const Reading& reading)
        : reading_(reading), oldTable_(reading.table.get()) {}

    bool pass(std::string_view& line) final;
    bool wantsPlainTriples() const override { return isOver_; }
    void end() final { isAtEnd_ = true; }

    /// Runs a reader's work.
    /// @throws what the work throws
    template <class Work>
    auto explainFailures(const Work& work) {
        try {
            return work();
        } catch (const Exception& exception) {
            explain(exception.message());
            throw;
        }
    }

    /// Looks for surplus samples behind the last one that the reader took, and compares their
    /// number with the table's points; as meant only.
    /// @throws Exception  the format's data error
    void expectAllSamples(const LUT& lut, LineSource& lines);

protected:
    // Of a format. The views are good for the call.

    /// The text with which the book refuses data.
    virtual const char* dataError() const = 0;

    /// A line, trimmed, that may be only a part of one; replaced when the whole is there.
    /// @return false: there is more to come
    virtual bool isWhole(std::string_view&) { return true; }

    /// A line that is nobody's but the format's own: no rule of the above applies to it.
    virtual bool isVerbatim(std::string_view) { return false; }

    /// A line, trimmed, that ends the file whatever stands behind it. As meant the reader sees
    /// neither.
    virtual bool isEnd(std::string_view) { return false; }

    /// A line, trimmed, that begins with the comment mark, which stands alone: "# comment".
    /// @return whether the reader is to see it
    virtual bool takeComment(std::string_view) { return false; }

    /// A line, trimmed, whose first word begins with a letter and is no number.
    /// @return whether the reader is to see it
    virtual bool takeKeyword(std::string_view line) = 0;

    /// A line of numbers, on its way to the reader.
    /// @return whether the reader is to see it
    virtual bool takeNumbers(std::string_view) { return true; }

    /// By the book: any line but three plain decimals.
    virtual void watch(std::string_view) {}

    /// The reason of a failure by the book; empty: what the last line shows.
    virtual std::string reasonOf(std::string_view /*message*/, std::string_view /*lastLine*/) {
        return "";
    }

    bool isMeant() const { return reading_.isMeant; }
    std::uint64_t lineNumber() const { return reading_.lineNumber; }
    std::uint64_t sampleCount() const { return reading_.sampleCount; }
    bool isAtEnd() const { return isAtEnd_; }

    void remark(const std::string& kind, const std::string& text) {
        remarkAt(lineNumber(), kind, text);
    }
    void remarkAt(std::uint64_t line, const std::string& kind, const std::string& text) {
        reading_.remarks.add(kind, line, text);
    }

    /// Fails with a text of the book and its reason.
    [[noreturn]] void fail(const char* message, const std::string& reason);

    /// Fails on a line that tells a file of another format, whose numbers would make another look.
    /// @throws Exception  the data error
    void expectOwnFormat(std::string_view line);

    /// Remarks a keyword that is not known, by its line, and what more there is to say.
    /// @throws Exception  the data error: of a misspelt sample, and as expectOwnFormat
    void remarkUnknown(std::string_view line, const std::string& more = "");

    /// The finite numbers behind a keyword.
    /// @param count       how many there have to be; those that are missing in three are 0
    /// @throws Exception  the data error
    RGB expectNumbersBehind(std::string_view line, std::size_t count);

    /// Points along a side, or entries: a whole number from 2 on.
    /// @param message  of the book, for a word that is none
    int expectSize(std::string_view word, const char* message);

    /// The two numbers behind a keyword as the range of all channels.
    /// @throws Exception  the data error
    Range expectRangeBehind(std::string_view line);
    void expectRising(const Range& range);

    /// Why a file that ends too early fails.
    /// @param points  of the table; 0: not known
    std::string endReason(std::uint64_t points) const;

private:
    void explain(const char* message);
    bool hasReturnsForLineEnds() const;
    std::string endReason() const;
    bool passMeant(std::string_view& line);
    void putMarkApart(std::string_view& line);
    void replaceDecimalCommas(std::string_view& line);
    void expectNumbers(std::string_view line);

    Reading reading_;
    const LUT* oldTable_;   // of the read before
    std::string lastLine_;  // that was no triple of plain decimals
    std::uint64_t lastLineNumber_ = 0;
    std::string rewritten_;  // a line in the spelling of the book
    bool isOver_ = false;    // as meant: behind the line that isEnd
    bool isAtEnd_ = false;
    bool isExplained_ = false;
};

/// A word as people want to see it: in quotation marks, cut if it is long, control characters as
/// "\r" and the like.
std::string quoted(std::string_view word);

/// "the file ends after 1 of 8 samples"
std::string endsEarly(std::uint64_t sampleCount, std::uint64_t points);

}  // namespace Orlith::LUT
