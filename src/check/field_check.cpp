#include "check/field_check.h"

#include <algorithm>

#include "tags/field_condition.h"

namespace zebtell::check {
namespace {

using Place = HtmlReader::Place;

constexpr std::size_t kShownCharacters = 40;
constexpr std::string_view kTextModifier = "zeb:";
constexpr std::string_view kDateModifier = "zebdate";

std::string Shown(std::string_view text) {
    std::string shown = base::WithoutControls(base::FirstCharacters(text, kShownCharacters));
    return shown.size() < text.size() ? shown + "..." : shown;
}

bool IsOwnWord(const FieldTag& tag, std::string_view reference) {
    return std::any_of(tag.own_words.begin(), tag.own_words.end(), [&](std::string_view word) {
        return word.ends_with('*')
                   ? base::StartsWithNoCase(reference, word.substr(0, word.size() - 1))
                   : base::EqualNoCase(reference, word);
    });
}

bool IsTextModifier(std::string_view modifier) {
    return base::StartsWithNoCase(modifier, kTextModifier);
}

bool IsModifierWord(std::string_view word) {
    word = base::Trimmed(word);
    for (std::string_view known : {"nospace", "quote", "attr"}) {
        if (base::EqualNoCase(word, known)) return true;
    }
    return base::StartsWithNoCase(word, "len=") && base::ParseNumber(word.substr(4));
}

// One of a reference's alternatives.
class PartCheck {
  public:
    PartCheck(PageReading& reading, const FieldTag& tag, std::string_view part)
        : reading_(reading), tag_(tag), part_(part) {}

    void Run(Place place) {
        if (part_.starts_with('?')) {
            CheckCondition();
            return;
        }
        const std::size_t mark = part_.find(';');
        const std::string_view field = base::Trimmed(part_.substr(0, mark));
        const bool is_modified = mark != part_.npos;
        const std::string_view modifier = is_modified ? part_.substr(mark + 1) : "";
        CheckField(field);
        if (IsTextModifier(modifier)) CheckWords(modifier.substr(kTextModifier.size()));
        CheckPlace(place, is_modified && EscapesQuotes(field, modifier));
    }

  private:
    void Report(const std::string& text) {
        reading_.Report(tag_.name, std::string(tag_.name) + ": " + text);
    }

    void CheckCondition() {
        if (const auto condition = tags::ParseCondition(part_.substr(1))) {
            CheckField(base::Trimmed(condition->field));
        } else {
            Report("the condition " + Shown(part_) + " has no test or no \";\" behind it");
        }
    }

    void CheckField(std::string_view field) {
        if (field.empty()) {
            Report("no field is named");
        } else if (!tag_.table.empty() && !reading_.tables.HasField(tag_.table, field)) {
            Report(std::string(tag_.table) + " has no field " + Shown(field));
        }
    }

    void CheckWords(std::string_view words) {
        for (std::string_view word : base::Split(words, ',')) {
            if (!IsModifierWord(word)) Report("zeb: has no word " + Shown(word));
        }
    }

    // Numbers and dates hold no quotation marks, but pictures leave other texts as they are.
    bool EscapesQuotes(std::string_view field, std::string_view modifier) const {
        if (IsTextModifier(modifier)) {
            return base::FindNoCase(modifier, "quote") != modifier.npos ||
                   base::FindNoCase(modifier, "attr") != modifier.npos;
        }
        return base::EndsWithNoCase(modifier, kDateModifier) ||
               !reading_.tables.IsText(tag_.table, field);
    }

    void CheckPlace(Place place, bool is_safe) {
        if (place == Place::kQuotedValue && !is_safe) {
            Report("a field in an attribute value needs zeb:attr or zeb:quote");
        } else if (place == Place::kBareValue || place == Place::kMarkup) {
            Report("a field inside of a tag's markup needs quotation marks around it");
        }
    }

    PageReading& reading_;
    const FieldTag& tag_;
    const std::string_view part_;
};

}  // namespace

void CheckReference(PageReading& reading,
                    const FieldTag& tag,
                    std::string_view reference,
                    Place place) {
    reference = base::Trimmed(reference);
    if (reference.empty()) return PartCheck(reading, tag, reference).Run(Place::kText);
    if (IsOwnWord(tag, reference)) return;
    for (std::string_view part : base::Split(reference, '|')) {
        PartCheck(reading, tag, part).Run(place);
    }
}

std::vector<std::string_view> ConditionOutputs(std::string_view reference) {
    std::vector<std::string_view> outputs;
    for (std::string_view part : base::Split(base::Trimmed(reference), '|')) {
        if (!part.starts_with('?')) continue;
        if (const auto condition = tags::ParseCondition(part.substr(1))) {
            outputs.push_back(condition->output);
        }
    }
    return outputs;
}

}  // namespace zebtell::check
