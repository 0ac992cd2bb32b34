#include "lut/io/Remarks.h"

namespace Orlith::LUT {
namespace {

constexpr std::uint64_t kMostOfAKind = 5;

}  // namespace

void Remarks::add(const std::string& kind, std::uint64_t line, const std::string& text) {
    if (++counts_[kind] <= kMostOfAKind) kept_.push_back({{line, text}, kind});
}

void Remarks::addLast(std::uint64_t line, const std::string& text) {
    kept_.push_back({{line, text}, ""});
}

void Remarks::clear() {
    kept_.clear();
    counts_.clear();
}

std::vector<Remark> Remarks::list() const {
    std::vector<Remark> list;
    std::map<std::string, std::uint64_t> listed;
    for (const auto& [remark, kind] : kept_) {
        list.push_back(remark);
        if (kind.empty() || ++listed[kind] < kMostOfAKind) continue;
        const std::uint64_t more = counts_.at(kind) - kMostOfAKind;
        if (more > 0) list.push_back({0, "and " + std::to_string(more) + " more like this one"});
    }
    return list;
}

}  // namespace Orlith::LUT
