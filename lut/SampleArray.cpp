#include "lut/SampleArray.h"

#include <sys/mman.h>
#include <unistd.h>

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <new>
#include <stdexcept>
#include <type_traits>

namespace Orlith::LUT {
namespace {

static_assert(std::is_trivially_copyable_v<RGB>, "samples are moved as bytes");

/// Blocks of this size and above are pages of their own, smaller ones come from the heap.
constexpr std::size_t kPagedBytes = std::size_t{1} << 20;

bool isPaged(std::size_t byteCount) {
    return byteCount >= kPagedBytes;
}

std::byte* orThrow(void* block) {
    if (block == nullptr || block == MAP_FAILED) throw std::bad_alloc();
    return static_cast<std::byte*>(block);
}

/// @return zeros; null for none
std::byte* allocate(std::size_t byteCount) {
    if (byteCount == 0) return nullptr;
    if (!isPaged(byteCount)) return orThrow(std::calloc(byteCount, 1));
    // No reserve: what is claimed may exceed the memory that there is.
    return orThrow(mmap(nullptr, byteCount, PROT_READ | PROT_WRITE,
                        MAP_PRIVATE | MAP_ANONYMOUS | MAP_NORESERVE, -1, 0));
}

void release(std::byte* block, std::size_t byteCount) {
    if (isPaged(byteCount)) {
        munmap(block, byteCount);
    } else {
        std::free(block);
    }
}

#ifdef __linux__
/// Gives a block of pages another size by moving pages, not bytes.
std::byte* resizePages(std::byte* block, std::size_t oldBytes, std::size_t newBytes) {
    std::byte* const moved = orThrow(mremap(block, oldBytes, newBytes, MREMAP_MAYMOVE));
    // What is left of the last page must be zero when the block grows again.
    const auto pageBytes = static_cast<std::size_t>(sysconf(_SC_PAGESIZE));
    const std::size_t pagesEnd = (newBytes + pageBytes - 1) / pageBytes * pageBytes;
    if (newBytes < oldBytes)
        std::memset(moved + newBytes, 0, std::min(oldBytes, pagesEnd) - newBytes);
    return moved;
}
#endif

std::byte* resizeBlock(std::byte* block, std::size_t oldBytes, std::size_t newBytes) {
#ifdef __linux__
    if (isPaged(oldBytes) && isPaged(newBytes)) return resizePages(block, oldBytes, newBytes);
#endif
    std::byte* const moved = allocate(newBytes);
    if (const std::size_t kept = std::min(oldBytes, newBytes)) std::memcpy(moved, block, kept);
    release(block, oldBytes);
    return moved;
}

std::byte* bytesOf(RGB* samples) {
    return reinterpret_cast<std::byte*>(samples);
}

}  // namespace

SampleArray::~SampleArray() {
    release(bytesOf(samples_), sampleCount_ * sizeof(RGB));
}

void SampleArray::resize(std::size_t sampleCount) {
    if (sampleCount > std::numeric_limits<std::size_t>::max() / sizeof(RGB) / 2) {
        throw std::length_error("SampleArray::resize");
    }
    samples_ = reinterpret_cast<RGB*>(
        resizeBlock(bytesOf(samples_), sampleCount_ * sizeof(RGB), sampleCount * sizeof(RGB)));
    sampleCount_ = sampleCount;
}

}  // namespace Orlith::LUT
