#include "demo/article_names.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <string_view>
#include <vector>

#include "base/text.h"

namespace zebtell::demo {
namespace {

using Parts = std::vector<std::string_view>;

constexpr std::array kMakers = {
    "Põhjanael", "D'Ambra", "Raudnaru", "Kalju & Pojad", "Žigulis", "Tõrvik", "Ūdensroze", "Äike"};

Parts PartsOf(std::string_view list) {
    Parts parts = base::Split(list, '|');
    return parts.empty() ? Parts{""} : parts;
}

// Takes the next digit of a number written in a mixed base: which of the choices it is.
std::size_t TakeDigit(std::size_t& number, const Parts& choices) {
    const std::size_t digit = number % choices.size();
    number /= choices.size();
    return digit;
}

std::string MakerOf(std::size_t series) {
    const std::size_t turn = (series - 1) / kMakers.size();
    const std::string maker = kMakers[(series - 1) % kMakers.size()];
    return turn == 0 ? maker : maker + " " + std::to_string(turn + 1);
}

// The size as a part of a code: "M8", "2.5" for "2,5", "040" for a whole length of 40.
std::string CodePart(std::string_view size, std::size_t least_digits) {
    std::string part;
    for (unsigned char letter : size) {
        if (letter == ',') {
            part += '.';
        } else if (letter < 0x80 && std::isalnum(letter) != 0) {
            part += static_cast<char>(std::toupper(letter));
        }
    }
    const bool whole = std::all_of(
        part.begin(), part.end(), [](unsigned char letter) { return std::isdigit(letter) != 0; });
    if (whole && part.size() < least_digits) {
        part.insert(0, least_digits - part.size(), '0');
    }
    return part;
}

// One of the combinations of a kind.
struct Choice {
    std::string_view name;
    std::string_view size;
    std::string_view length;
    std::string_view finish;
    std::size_t variant;  // among the articles of that size and length
    std::size_t series;   // how often the combination has come before
    int size_per_mille;
};

Choice ChoiceOf(const ArticleKind& kind, std::size_t number) {
    const Parts names = PartsOf(kind.names);
    const Parts sizes = PartsOf(kind.sizes);
    const Parts lengths = PartsOf(kind.lengths);
    const Parts finishes = PartsOf(kind.finishes);
    const std::size_t all = names.size() * sizes.size() * lengths.size() * finishes.size();
    constexpr std::size_t kStride = 7919;  // a prime, so that it visits every combination once

    std::size_t rest = number * kStride % all;
    const std::size_t size = TakeDigit(rest, sizes);
    const std::size_t name = TakeDigit(rest, names);
    const std::size_t length = TakeDigit(rest, lengths);
    const std::size_t finish = TakeDigit(rest, finishes);
    const std::size_t series = number / all;
    return {names[name],
            sizes[size],
            lengths[length],
            finishes[finish],
            (series * names.size() + name) * finishes.size() + finish,
            series,
            static_cast<int>(size * 1000 / sizes.size())};
}

std::string CodeOf(const ArticleKind& kind, const Choice& choice) {
    std::string code = std::string(kind.code) + "-" + CodePart(choice.size, 1);
    if (!choice.length.empty()) {
        code += "-" + CodePart(choice.length, 3);
    }
    return choice.variant == 0 ? code : code + "-" + std::to_string(choice.variant);
}

std::string WithSize(std::string_view name, const std::string& size) {
    return name.find('%') == std::string_view::npos ? std::string(name) + " " + size
                                                    : base::Replaced(name, "%", size);
}

std::string FullName(const Choice& choice) {
    std::string measure(choice.size);
    if (!choice.length.empty()) {
        measure.append("×").append(choice.length);
    }
    std::string name = WithSize(choice.name, measure);
    if (!choice.finish.empty()) {
        name.append(" ").append(choice.finish);
    }
    return choice.series == 0 ? name : name + ", " + MakerOf(choice.series);
}

}  // namespace

ArticleName NameOf(const ArticleKind& kind, int number) {
    const Choice choice = ChoiceOf(kind, static_cast<std::size_t>(number));
    return {CodeOf(kind, choice), FullName(choice), choice.size_per_mille};
}

std::string Ean13(std::int64_t first_digits) {
    std::string digits = std::to_string(first_digits);
    int sum = 0;
    for (std::size_t i = 0; i < digits.size(); ++i) {
        sum += (digits[i] - '0') * (i % 2 == 0 ? 1 : 3);
    }
    return digits + static_cast<char>('0' + (10 - sum % 10) % 10);
}

}  // namespace zebtell::demo
