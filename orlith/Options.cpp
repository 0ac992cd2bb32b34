#include "orlith/Options.h"

#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include <algorithm>
#include <charconv>
#include <cmath>
#include <numeric>
#include <system_error>
#include <utility>

namespace orlith {
namespace {

constexpr int kMostPreLUTEntries = 65536;

template <class Number>
bool parseWhole(std::string_view word, Number& number) {
    if (word.size() > 1 && word[0] == '+' && word[1] != '-') word.remove_prefix(1);
    Number parsed{};
    const char* const end = word.data() + word.size();
    const auto result = std::from_chars(word.data(), end, parsed);
    if (result.ec != std::errc() || result.ptr != end) return false;
    number = parsed;
    return true;
}

/// Insertions, deletions, replacements and swaps of neighbours that turn one word into another.
std::size_t editDistance(const std::string& a, const std::string& b) {
    std::vector<std::vector<std::size_t>> rows(a.size() + 1,
                                               std::vector<std::size_t>(b.size() + 1));
    std::iota(rows[0].begin(), rows[0].end(), std::size_t{0});
    for (std::size_t i = 1; i <= a.size(); ++i) {
        rows[i][0] = i;
        for (std::size_t j = 1; j <= b.size(); ++j) {
            const std::size_t replaced = rows[i - 1][j - 1] + (a[i - 1] == b[j - 1] ? 0 : 1);
            rows[i][j] = std::min({replaced, rows[i - 1][j] + 1, rows[i][j - 1] + 1});
            if (i > 1 && j > 1 && a[i - 1] == b[j - 2] && a[i - 2] == b[j - 1]) {
                rows[i][j] = std::min(rows[i][j], rows[i - 2][j - 2] + 1);
            }
        }
    }
    return rows.back().back();
}

}  // namespace

bool parseInteger(std::string_view word, int& number) {
    return parseWhole(word, number);
}

bool parseReal(std::string_view word, double& number) {
    if (word.substr(0, 2) == " -") word.remove_prefix(1);
    return parseWhole(word, number);
}

std::string markedNegative(const std::string& word) {
    // The parser knows numbers by their digit.
    const bool looksLikeOption =
        word.size() > 1 && word[0] == '-' && (word[1] < '0' || word[1] > '9');
    double ignored = 0.0;
    return looksLikeOption && parseReal(word, ignored) ? " " + word : word;
}

CLI::App* addCommand(CLI::App& program, const std::string& name, const std::string& description) {
    return program.add_subcommand(name, description);
}

CLI::Option* addInteger(CLI::App& command, const std::string& name, int least, int most,
                        const std::string& description, std::function<void(int)> use) {
    return command
        .add_option_function<std::string>(
            name,
            [=, use = std::move(use)](const std::string& word) {
                int number = 0;
                if (!parseInteger(word, number) || number < least || number > most) {
                    throw CLI::ValidationError(
                        name, fmt::format("\"{}\" has to be a whole number from {} to {}", word,
                                          least, most));
                }
                use(number);
            },
            description)
        ->type_name("N");
}

CLI::Option* addReal(CLI::App& command, const std::string& name, const std::string& description,
                     std::function<void(double)> use) {
    return command
        .add_option_function<std::string>(
            name,
            [=, use = std::move(use)](const std::string& word) {
                double number = 0.0;
                if (!parseReal(word, number) || !std::isfinite(number)) {
                    throw CLI::ValidationError(name,
                                               fmt::format("\"{}\" has to be a number", word));
                }
                use(number);
            },
            description)
        ->type_name("X");
}

std::string wrongPreLUTSize(const std::string& word) {
    int count = 0;
    const bool isGood =
        parseInteger(word, count) && (count == 0 || (count >= 2 && count <= kMostPreLUTEntries));
    return isGood ? ""
                  : fmt::format("\"{}\" has to be 0 (none) or a whole number from 2 to {}", word,
                                kMostPreLUTEntries);
}

std::optional<std::string> nearestName(const std::string& word,
                                       const std::vector<std::string>& names) {
    const auto distance = [&](const std::string& name) { return editDistance(word, name); };
    const auto nearest =
        std::min_element(names.begin(), names.end(),
                         [&](const auto& a, const auto& b) { return distance(a) < distance(b); });
    if (nearest == names.end()) return std::nullopt;
    const bool isMeant = distance(*nearest) <= std::max<std::size_t>(2, word.size() / 3) ||
                         (word.size() > 2 && nearest->rfind(word, 0) == 0);
    return isMeant ? std::optional(*nearest) : std::nullopt;
}

}  // namespace orlith
