#include "host/ProgressDisplay.h"

#include <fmt/format.h>
#include <unistd.h>

#include <algorithm>

namespace host {
namespace {

constexpr std::size_t kBarColumns = 20;
constexpr std::size_t kMessageColumns = 50;  // with the bar, within the 80 of a small terminal
constexpr std::size_t kStatusColumns = 79;
constexpr std::chrono::milliseconds kDrawInterval{50};
constexpr char kEraseLine[] = "\r\x1b[K";

}  // namespace

ProgressDisplay::ProgressDisplay() : ProgressDisplay(stderr, isatty(STDERR_FILENO) == 1) {}

ProgressDisplay::ProgressDisplay(std::FILE* terminal, bool isShown)
    : terminal_(terminal), isShown_(isShown) {}

ProgressDisplay::~ProgressDisplay() {
    clear();
}

void ProgressDisplay::message(const std::string& text) {
    message_ = text.substr(0, kMessageColumns);
    fraction_ = 0.0;
    nextDraw_ = {};
    draw();
}

void ProgressDisplay::fraction(double done) {
    fraction_ = done >= 0.0 ? std::min(done, 1.0) : 0.0;
    draw();
}

void ProgressDisplay::status(const std::string& text) {
    show(text.substr(0, kStatusColumns));
}

void ProgressDisplay::draw() {
    const auto filled = static_cast<std::size_t>(fraction_ * static_cast<double>(kBarColumns));
    const std::string bar = std::string(filled, '#') + std::string(kBarColumns - filled, ' ');
    show(fmt::format("{} [{}] {:3.0f}%", message_, bar, fraction_ * 100.0));
}

void ProgressDisplay::show(const std::string& text) {
    const Clock::time_point now = Clock::now();
    if (!isShown_ || now < nextDraw_) return;
    nextDraw_ = now + kDrawInterval;
    std::fputs((kEraseLine + text).c_str(), terminal_);
    std::fflush(terminal_);
    isDrawn_ = true;
}

void ProgressDisplay::clear() {
    if (!isDrawn_) return;
    std::fputs(kEraseLine, terminal_);
    std::fflush(terminal_);
    isDrawn_ = false;
    nextDraw_ = {};
}

}  // namespace host
