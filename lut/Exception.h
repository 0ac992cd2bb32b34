#pragma once

namespace Orlith::LUT {

/// The one failure of the library: a fixed text that says what is wrong.
///
/// Thrown by value and caught as `const Exception&`; it is no std::exception. Allocation and length
/// errors of the standard library pass through the library as they are.
class Exception {
public:
    /// @param message  static, NUL-terminated text; never copied, formatted or freed
    explicit constexpr Exception(const char* message) noexcept : message_(message) {}

    constexpr const char* message() const noexcept { return message_; }

private:
    const char* message_;
};

}  // namespace Orlith::LUT
