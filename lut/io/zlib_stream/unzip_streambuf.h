#pragma once

#include <zlib.h>

#include <algorithm>
#include <ios>
#include <istream>
#include <memory>
#include <streambuf>
#include <string>
#include <vector>

namespace zlib_stream {

/// Decompresses the raw deflate data that start where an input stream stands.
///
/// Data     end with the deflate stream, at the first fault in it (what was decoded before is
///          delivered), or with the source; then they stay at their end. No checksum is compared.
/// Source   stands right behind the deflate stream afterwards, if it can seek; if it cannot, it
///          fails, and up to one input buffer of what follows is lost.
/// Seeking  none; up to 4 characters can be put back, also across a refill and at the end.
/// Failure  no exceptions but those of allocation, or of a source that was told to throw.
/// Memory   two buffers, allocated at construction.
template <class Char, class Traits = std::char_traits<Char>,
          class CharAllocator = std::allocator<Char>, class ByteType = unsigned char,
          class ByteAllocator = std::allocator<ByteType>>
class basic_unzip_streambuf : public std::basic_streambuf<Char, Traits> {
    static_assert(sizeof(Char) == 1 && sizeof(ByteType) == 1, "a character is one byte of data");

public:
    using int_type = typename Traits::int_type;
    using istream_type = std::basic_istream<Char, Traits>;

    /// @param source           outlives this object
    /// @param windowSize       base-two logarithm of the compressor's window in bytes, 8 to 15;
    ///                         15 reads everything
    /// @param readBufferSize   decompressed characters with the room for put-back, raised to 5
    /// @param inputBufferSize  compressed bytes, raised to 1
    basic_unzip_streambuf(istream_type& source, int windowSize, uInt readBufferSize,
                          uInt inputBufferSize)
        : source_(source),
          input_(std::max(inputBufferSize, 1U)),
          output_(std::max(readBufferSize, kPutBack + 1)) {
        // Negative: raw data. After the buffers, whose allocation may throw.
        if (windowSize > 0) result_ = inflateInit2(&zlib_, -windowSize);
        Char* const start = output_.data() + kPutBack;
        this->setg(start, start, start);
    }
    basic_unzip_streambuf(const basic_unzip_streambuf&) = delete;
    basic_unzip_streambuf& operator=(const basic_unzip_streambuf&) = delete;
    ~basic_unzip_streambuf() override { inflateEnd(&zlib_); }

    /// zlib's last answer: Z_OK while there may be more data; at first, whether zlib could start.
    int result() const { return result_; }

    /// CRC-32 of everything decompressed so far.
    uLong crc() const { return crc_; }

protected:
    int_type underflow() override {
        if (this->gptr() < this->egptr()) return Traits::to_int_type(*this->gptr());

        Char* const start = output_.data() + kPutBack;
        const auto kept = std::min<std::ptrdiff_t>(this->gptr() - this->eback(), kPutBack);
        Traits::move(start - kept, this->gptr() - kept, static_cast<std::size_t>(kept));
        const uInt produced = decompress(start, static_cast<uInt>(output_.size()) - kPutBack);
        // Also when nothing came: the characters kept have moved.
        this->setg(start - kept, start, start + produced);
        return produced == 0 ? Traits::eof() : Traits::to_int_type(*start);
    }

private:
    static constexpr uInt kPutBack = 4;

    /// Returns the number of characters stored, 0 at the end of the data.
    uInt decompress(Char* room, uInt capacity) {
        auto* const start = reinterpret_cast<Bytef*>(room);
        zlib_.next_out = start;
        zlib_.avail_out = capacity;
        while (result_ == Z_OK && zlib_.avail_out > 0) {
            // When the source has ended, zlib may still hold characters that found no room before;
            // once it holds none the answer is Z_BUF_ERROR.
            if (zlib_.avail_in == 0) fetch();
            result_ = inflate(&zlib_, Z_SYNC_FLUSH);
        }
        const uInt produced = capacity - zlib_.avail_out;
        crc_ = crc32(crc_, start, produced);
        if (result_ == Z_STREAM_END && zlib_.avail_in > 0) handBack();
        return produced;
    }

    void fetch() {
        source_.read(reinterpret_cast<Char*>(input_.data()),
                     static_cast<std::streamsize>(input_.size()));
        zlib_.next_in = reinterpret_cast<Bytef*>(input_.data());
        zlib_.avail_in = static_cast<uInt>(source_.gcount());
    }

    /// Moves the source back over the bytes that were read but do not belong to the data.
    void handBack() {
        source_.clear();  // a short read has left it at its end
        source_.seekg(-static_cast<std::streamoff>(zlib_.avail_in), std::ios_base::cur);
        zlib_.avail_in = 0;
    }

    istream_type& source_;
    z_stream zlib_{};
    int result_ = Z_STREAM_ERROR;
    std::vector<ByteType, ByteAllocator> input_;
    std::vector<Char, CharAllocator> output_;  // the first kPutBack are for characters put back
    uLong crc_ = 0;
};

using unzip_streambuf = basic_unzip_streambuf<char>;

}  // namespace zlib_stream
