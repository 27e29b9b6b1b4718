#include "import/item_values.h"

#include <algorithm>

#include "import/hash_fields.h"
#include "import/table_text.h"

namespace ryn {

namespace {

/// Counts a text; from a number of different ones on, the rest counts with the last.
void CountText(std::string_view text, std::vector<OccurredText>* texts) {
    constexpr std::size_t kMostTexts = 20; // a hostile table may have a new one in each row
    const std::string shown = ShownText(text);
    for (OccurredText& known : *texts) {
        if (known.text == shown || texts->size() == kMostTexts) {
            ++known.count;
            return;
        }
    }
    texts->push_back({shown, 1, {}});
}

} // namespace

ItemValues::ItemValues(const TableLayout& tableLayout, const MissingRules& missingRules,
                       ImportReport* importReport, BadRows* badRows)
    : layout(tableLayout),
      missing(missingRules),
      report(importReport),
      bad(badRows),
      decimals(tableLayout),
      emptyIsGiven(std::find(missing.texts.begin(), missing.texts.end(), "") !=
                   missing.texts.end()) {}

ValueResult ItemValues::CountMissing(std::string_view text) {
    CountText(text, &report->missing);
    return ValueResult::Missing;
}

bool ItemValues::IsGivenText(std::string_view text) const {
    return std::any_of(missing.texts.begin(), missing.texts.end(), [text](const std::string& code) {
        return Lowercase(code) == Lowercase(text);
    });
}

bool ItemValues::IsGiven(const NumberField& number, std::string_view field) const {
    const bool isNumber = number.kind == NumberKind::Value || number.kind == NumberKind::Marked;
    return (isNumber && std::find(missing.numbers.begin(), missing.numbers.end(), number.value) !=
                            missing.numbers.end()) ||
           IsGivenText(field);
}

ValueResult ItemValues::Refuse(long line, std::size_t column, std::string_view field,
                               NumberKind kind) {
    std::string fault = Quoted(field) + " in column " + ColumnTitle(layout, column);
    switch (kind) {
    case NumberKind::NotFinite:
        fault += " is not finite";
        break;
    case NumberKind::Grouped:
        fault += " has thousands separators, which are not read; export the table without them";
        break;
    case NumberKind::TooLarge:
        fault += " is too large for a 32-bit number";
        break;
    case NumberKind::Censored:
        // Taking the bound would make up an observation; half of it, as some do, even more so.
        fault += " is a bound and not a value; leave such rows out with --missing \"" +
                 std::string(field.substr(0, 1)) + "\", or edit them";
        break;
    default:
        if (IsHashField(field)) {
            fault += kHashAdvice;
            break;
        }
        fault += " is no number";
        if (std::none_of(field.begin(), field.end(), IsDigit))
            fault += "; if it marks a missing value say so with --missing";
    }
    bad->Add(line, fault);
    return ValueResult::Bad;
}

ValueResult ItemValues::Read(long line, std::size_t column, std::string_view field, float* value) {
    const NumberField number = ReadNumber(field, layout.decimal);
    if (number.kind == NumberKind::Missing)
        return CountMissing(field);
    // Given codes come before any refusal, so that a user can exclude what cannot be read, "inf"
    // included.
    if (!missing.texts.empty()) {
        if (IsGiven(number, field))
            return CountMissing(field);
        if (!number.mark.empty() && IsGivenText(number.mark))
            return CountMissing(number.mark);
    }
    if (number.kind == NumberKind::Marked)
        // Estimated and provisional values are what a record consists of; leaving them out would
        // bias it. The report tells them, and --missing excludes them by their mark.
        CountText(number.mark, &report->marks);
    else if (number.kind != NumberKind::Value)
        return Refuse(line, column, field, number.kind);
    decimals.Look(
        line, column,
        number.mark.empty() ? field : Trimmed(field.substr(0, field.size() - number.mark.size())));
    *value = number.value;
    return ValueResult::Taken;
}

} // namespace ryn
