#include "lut/io/zlib_stream/zip_istream.h"

#include <gtest/gtest.h>

#include <iterator>
#include <sstream>

#include "tests/support/Gzip.h"

namespace {

using namespace test;
using zlib_stream::zip_istream;

constexpr std::size_t kTrailerBytes = 8;

/// Text that compresses neither to nothing nor badly, and in which every place differs.
std::string countedLines(int lineCount) {
    std::string text;
    for (int i = 0; i < lineCount; ++i)
        text += std::to_string(i) + " of " + std::to_string(lineCount) + "\n";
    return text;
}

std::string rest(std::istream& stream) {
    return {std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>()};
}

std::string unzip(const std::string& bytes, unsigned readBuffer = 4096,
                  unsigned inputBuffer = 4096) {
    std::istringstream source(bytes);
    zip_istream stream(source, 15, readBuffer, inputBuffer);
    EXPECT_TRUE(stream.isGzip());
    return rest(stream);
}

TEST(ZipIstream, ReadsTextOfManyRefillsWithBuffersOfAnySize) {
    const std::string text = countedLines(6000);
    const std::string bytes = gzip(text);
    ASSERT_GT(bytes.size(), 3 * 4096U);
    for (const unsigned readBuffer : {0U, 1U, 4U, 5U, 6U, 9U, 4096U, 1U << 20}) {
        for (const unsigned inputBuffer : {0U, 1U, 7U, 4096U, 1U << 20}) {
            EXPECT_EQ(unzip(bytes, readBuffer, inputBuffer), text)
                << readBuffer << " and " << inputBuffer;
        }
    }
    EXPECT_EQ(unzip(gzip("")), "");
}

TEST(ZipIstream, LeavesASourceThatIsNotCompressedWhereItStood) {
    for (const std::string bytes : {"plain text", "\x1F", "\x1Fyes", "\x1F\x1F\x8B", "\x8B\x1F"}) {
        std::istringstream plain(bytes);
        EXPECT_FALSE(zip_istream(plain, 15, 4096, 4096).isGzip());
        EXPECT_TRUE(plain.good());
        EXPECT_EQ(rest(plain), bytes);
    }
    std::istringstream empty("");
    EXPECT_FALSE(zip_istream(empty, 15, 4096, 4096).isGzip());
    std::istringstream source(gzip("text"));
    zip_istream stream(source, 3, 4096, 4096);  // a window with which zlib cannot start
    EXPECT_FALSE(stream.isGzip());
    EXPECT_EQ(source.tellg(), 0);
    EXPECT_EQ(rest(stream), "");
}

TEST(ZipIstream, SkipsEveryCombinationOfHeaderFields) {
    const std::string text = countedLines(10);
    for (unsigned which = 0; which < 16; ++which) {
        GzipFields fields;
        if ((which & 1U) != 0) fields.extra = std::string(0x0123, '\0');
        if ((which & 2U) != 0) fields.name = "look.vf";
        if ((which & 4U) != 0) fields.comment = "by \xE9toile";
        fields.headerCrc = (which & 8U) != 0;
        EXPECT_EQ(unzip(gzip(text, fields)), text) << which;
    }
    // Of an unknown method or with an unknown field it still was gzip, but not this text.
    for (const auto& [place, byte] : {std::pair(2U, '\x07'), {3U, '\x20'}, {3U, '\x80'}}) {
        std::string bytes = gzip(text);
        bytes[place] = byte;
        EXPECT_NE(unzip(bytes), text);
    }
}

TEST(ZipIstream, StandsAtTheTrailerAfterTheFirstMember) {
    const std::string text = countedLines(3000);
    const std::string member = gzip(text);
    for (const std::string& after : {std::string(), std::string("unrelated"), gzip("second")}) {
        std::istringstream source(member + after);
        zip_istream stream(source, 15, 4096, 4096);
        EXPECT_EQ(rest(stream), text);
        EXPECT_EQ(stream.rdbuf()->result(), Z_STREAM_END);
        EXPECT_EQ(rest(source), member.substr(member.size() - kTrailerBytes) + after);
    }
}

/// A source that cannot seek, as a pipe cannot.
class OneWay : public std::stringbuf {
public:
    using std::stringbuf::stringbuf;

protected:
    pos_type seekoff(off_type, std::ios_base::seekdir, std::ios_base::openmode) override {
        return pos_type(off_type(-1));
    }
};

TEST(ZipIstream, DeliversAllOfASourceThatCannotSeek) {
    const std::string text = countedLines(3000);
    OneWay bytes(gzip(text) + "unrelated");
    std::istream source(&bytes);
    zip_istream stream(source, 15, 4096, 4096);
    EXPECT_EQ(rest(stream), text);
    EXPECT_TRUE(source.fail());
}

TEST(ZipIstream, ComputesTheChecksumAndDoesNotCompareIt) {
    std::string bytes = gzip("123456789");
    bytes[bytes.size() - kTrailerBytes] ^= '\x55';
    std::istringstream source(bytes);
    zip_istream stream(source, 15, 4096, 4096);
    EXPECT_EQ(rest(stream), "123456789");
    EXPECT_EQ(stream.rdbuf()->crc(), 0xCBF43926U);  // the check value published for CRC-32
    EXPECT_EQ(stream.gzipCrc(), 0U);
    EXPECT_EQ(stream.gzipDataSize(), 0U);
}

TEST(ZipIstream, DeliversWhatComesBeforeACutOrAFault) {
    // Ends in a run, of which one byte of data holds hundreds of characters.
    const std::string text = countedLines(400) + std::string(3000, 'x');
    const std::string bytes = gzip(text, {"extra", "name", "comment", true});
    for (std::size_t byteCount = 2; byteCount < bytes.size(); ++byteCount) {
        const std::string cut = bytes.substr(0, byteCount);
        const std::string got = unzip(cut);
        ASSERT_EQ(got, text.substr(0, got.size())) << byteCount;
        // One character a refill, so that the source ends while zlib still holds many.
        ASSERT_EQ(unzip(cut, 5), got) << byteCount;
        if (byteCount >= bytes.size() - kTrailerBytes) {
            ASSERT_EQ(got.size(), text.size());
        }
    }
    // A block of the reserved type 3 right after a whole first one (stored, not the last).
    const std::string magic("\x1F\x8B\x08\0\0\0\0\0\0\0", 10);
    EXPECT_EQ(unzip(magic + std::string("\x00\x02\x00\xFD\xFFok\x07", 8) + "more"), "ok");
}

TEST(ZipIstream, TakesBackFourCharacters) {
    const std::string text = countedLines(2000);
    const std::string bytes = gzip(text);
    // At places around refills of 4092 and of 1 characters, and at the end.
    const std::size_t places[] = {4, 4091, 4092, 4093, 4095, text.size()};
    for (const unsigned readBuffer : {4096U, 5U, 6U}) {
        for (const std::size_t place : places) {
            SCOPED_TRACE(place);
            std::istringstream source(bytes);
            zip_istream stream(source, 15, readBuffer, 4096);
            stream.ignore(static_cast<std::streamsize>(place));
            if (stream.peek() == EOF) stream.clear();
            for (int i = 0; i < 4; ++i)
                stream.unget();
            ASSERT_TRUE(stream.good());
            ASSERT_EQ(rest(stream), text.substr(place - 4));
        }
    }
    std::istringstream source(bytes);
    EXPECT_FALSE(zip_istream(source, 15, 5, 4096).unget().good());  // before the first
}

}  // namespace
