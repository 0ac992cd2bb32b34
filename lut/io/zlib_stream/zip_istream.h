// Reading gzip data from any input stream, as plain characters.
//
//   1F 8B               magic
//   08                  method: deflate
//   flags               which of the optional fields follow
//   6 bytes             time, compression level, operating system
//   length, bytes       extra field, if 04 is set; 16-bit length, low byte first
//   text, 00            file name, if 08
//   text, 00            comment, if 10
//   2 bytes             checksum of the header, if 02
//   raw deflate data    what the stream delivers
//   CRC-32, length      never read

#pragma once

#include <istream>
#include <limits>

#include "lut/io/zlib_stream/unzip_streambuf.h"

namespace zlib_stream {

/// Owner of the stream buffer: a base, so that the buffer is there before the stream that uses it.
template <class Char, class Traits = std::char_traits<Char>,
          class CharAllocator = std::allocator<Char>, class ByteType = unsigned char,
          class ByteAllocator = std::allocator<ByteType>>
class basic_zip_istreambase {
public:
    using streambuf_type =
        basic_unzip_streambuf<Char, Traits, CharAllocator, ByteType, ByteAllocator>;
    using istream_type = typename streambuf_type::istream_type;

    basic_zip_istreambase(istream_type& source, int windowSize, uInt readBufferSize,
                          uInt inputBufferSize)
        : buffer_(source, windowSize, readBufferSize, inputBufferSize) {}

    streambuf_type* rdbuf() { return &buffer_; }

private:
    streambuf_type buffer_;
};

/// The decompressed text of the first gzip member that starts where a source stands.
///
/// A source that does not start with gzip's two magic bytes is left as it was found (isGzip says
/// so): read it directly. A broken header shows in the data, which are then missing or garbled;
/// broken data end early; a wrong checksum goes unnoticed. See basic_unzip_streambuf for the rest.
template <class Char, class Traits = std::char_traits<Char>,
          class CharAllocator = std::allocator<Char>, class ByteType = unsigned char,
          class ByteAllocator = std::allocator<ByteType>>
class basic_zip_istream
    : public basic_zip_istreambase<Char, Traits, CharAllocator, ByteType, ByteAllocator>,
      public std::basic_istream<Char, Traits> {
    using Base = basic_zip_istreambase<Char, Traits, CharAllocator, ByteType, ByteAllocator>;

public:
    using istream_type = typename Base::istream_type;
    using Base::rdbuf;

    /// Reads the gzip header. The parameters are those of basic_unzip_streambuf.
    basic_zip_istream(istream_type& source, int windowSize, uInt readBufferSize,
                      uInt inputBufferSize)
        : Base(source, windowSize, readBufferSize, inputBufferSize), istream_type(Base::rdbuf()) {
        if (rdbuf()->result() != Z_OK) return;
        isGzip_ = takeMagic(source);
        if (isGzip_) skipHeader(source);
    }

    /// True when the source started with gzip's magic bytes.
    bool isGzip() const { return isGzip_; }

    /// Deliberate: always 0, as the trailer that holds the member's CRC-32 and length is not read.
    uLong gzipCrc() const { return gzipCrc_; }
    uLong gzipDataSize() const { return gzipDataSize_; }

private:
    enum Flag : unsigned {
        kHeaderCrc = 0x02,
        kExtraField = 0x04,
        kName = 0x08,
        kComment = 0x10,
        kReserved = 0xE0
    };

    /// Takes the two bytes if both are there, else none.
    static bool takeMagic(istream_type& source) {
        if (!Traits::eq_int_type(source.peek(), 0x1F)) return false;
        source.get();
        if (!Traits::eq_int_type(source.peek(), 0x8B)) {
            source.unget();  // this also forgives the end of input met behind the first byte
            return false;
        }
        source.get();
        return true;
    }

    static void skipHeader(istream_type& source) {
        constexpr std::streamsize kAll = std::numeric_limits<std::streamsize>::max();
        const auto zero = Traits::to_int_type(Char());

        const unsigned method = takeByte(source);
        const unsigned flags = takeByte(source);
        if (method != Z_DEFLATED || (flags & kReserved) != 0) return;
        source.ignore(6);
        if ((flags & kExtraField) != 0) {
            const unsigned low = takeByte(source);
            const unsigned high = takeByte(source);
            source.ignore(256 * high + low);
        }
        if ((flags & kName) != 0) source.ignore(kAll, zero);
        if ((flags & kComment) != 0) source.ignore(kAll, zero);
        if ((flags & kHeaderCrc) != 0) source.ignore(2);
    }

    /// 0 at the end of the source.
    static unsigned takeByte(istream_type& source) {
        const auto byte = source.get();
        if (Traits::eq_int_type(byte, Traits::eof())) return 0;
        return static_cast<unsigned char>(Traits::to_char_type(byte));
    }

    bool isGzip_ = false;
    uLong gzipCrc_ = 0;
    uLong gzipDataSize_ = 0;
};

using zip_istreambase = basic_zip_istreambase<char>;
using zip_istream = basic_zip_istream<char>;

}  // namespace zlib_stream
