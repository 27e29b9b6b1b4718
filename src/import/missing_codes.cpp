#include "import/missing_codes.h"

#include <algorithm>
#include <cmath>

#include "base/number_text.h"

namespace ryn {

namespace {

struct Extreme {
    float value = 0.0F;
    long count = 0;
};

/// The few most extreme distinct values of a series, the outermost first, with their counts.
class Extremes {
  public:
    explicit Extremes(float outwardSign) : sign(outwardSign) {}

    void Add(float value) {
        const float outward = sign * value;
        // Nearly every value ends here.
        if (found.size() == kKept && outward < sign * found.back().value)
            return;
        auto at = std::find_if(found.begin(), found.end(), [this, outward](const Extreme& known) {
            return sign * known.value <= outward;
        });
        if (at != found.end() && at->value == value) {
            ++at->count;
            return;
        }
        found.insert(at, {value, 1});
        if (found.size() > kKept)
            found.pop_back();
    }
    const std::vector<Extreme>& All() const { return found; }

  private:
    static constexpr std::size_t kKept = 6;

    float sign;
    std::vector<Extreme> found;
};

/// Digits of a number's shortest text, without zeros at its end.
std::string DigitsOf(float value) {
    std::string digits;
    // Three decimals hold every code in use ("-99.99"), and cut what conversion to 32 bits adds.
    for (const char c : FixedText(static_cast<double>(std::abs(value)), 3))
        if (c >= '0' && c <= '9')
            digits += c;
    digits.erase(0, std::min(digits.find_first_not_of('0'), digits.size()));
    while (!digits.empty() && digits.back() == '0')
        digits.pop_back();
    return digits;
}

/// One of these digits, so many times or more, and nothing else.
bool IsRepeatedDigit(const std::string& digits, std::string_view which, std::size_t least) {
    return digits.size() >= least && which.find(digits[0]) != std::string_view::npos &&
           digits.find_first_not_of(digits[0]) == std::string::npos;
}

/// Nothing on earth is measured in such numbers; netCDF's and most models' fill values lie here.
bool IsHuge(float value) {
    return std::abs(value) >= 1e19F;
}

/// The lowest value of an integer of 16 or 32 bits, and its neighbour that netCDF uses.
bool IsIntegerLimit(float value) {
    return value == -32768.0F || value == -32767.0F || value == -2147483648.0F;
}

/// 99999999 and longer rows of nines, which a 32-bit number rounds to a power of ten.
bool IsRoundedNines(float value) {
    return std::abs(value) >= 1e8F && DigitsOf(value) == "1";
}

/// By its look alone; whether it is one depends on the other values.
bool IsLowCode(float value) {
    if (value >= 0.0F)
        return false;
    const std::string digits = DigitsOf(value);
    return IsHuge(value) || IsRoundedNines(value) || IsIntegerLimit(value) || value == -1.0F ||
           value == -9.0F || (std::abs(value) >= 9.0F && IsRepeatedDigit(digits, "9", 2)) ||
           (std::abs(value) >= 66.0F && IsRepeatedDigit(digits, "678", 3));
}

bool IsHighCode(float value) {
    return IsHuge(value) || IsRoundedNines(value) ||
           (value >= 9.0F && IsRepeatedDigit(DigitsOf(value), "9", 2));
}

/// The values that are no candidates for codes.
struct Rest {
    float low = 0.0F;
    float high = 0.0F;
    bool isEmpty = true;

    void Include(float value) {
        low = isEmpty ? value : std::min(low, value);
        high = isEmpty ? value : std::max(high, value);
        isEmpty = false;
    }
};

/// Negative codes. In a series without other negative values (discharge, rain) a code needs little
/// proof, in others it has to lie far outside.
bool IsClearLow(const Extreme& code, const Rest& rest, bool isFine) {
    if (IsHuge(code.value) || rest.isEmpty)
        return code.value != -1.0F && code.value != -9.0F;
    const bool isOnlyNegative = rest.low >= 0.0F;
    if (code.value == -1.0F || code.value == -9.0F)
        // Whole numbers may be degrees, or the "-1" that stands for a trace of rain.
        return isOnlyNegative && isFine && code.count >= 3;
    if (isOnlyNegative)
        return code.count >= 2 || DigitsOf(code.value).size() >= 3;
    // Levels and temperatures go below zero; a code lies further below them than they spread.
    return rest.low - code.value > rest.high - rest.low;
}

/// Nines. High values are what an extreme value analysis is about, so that the proof has to be
/// strong: repeated, and further off than the whole series spreads or is high.
bool IsClearHigh(const Extreme& code, const Rest& rest) {
    if (IsHuge(code.value))
        return true;
    if (rest.isEmpty)
        return code.count >= 3;
    const float gap = code.value - rest.high;
    // A flood may reach 999 once. It does not do so three times to the last digit, with nothing
    // near it.
    return code.count >= 3 && gap > rest.high - rest.low && gap > std::abs(rest.high);
}

/// The codes of one series.
class CodeSearch {
  public:
    explicit CodeSearch(const std::vector<float>& series) : low(-1.0F), high(1.0F) {
        for (const float value : series) {
            if (!(value == value))
                continue;
            low.Add(value);
            high.Add(value);
            isFine = isFine || (value != std::floor(value) && !IsHuge(value));
        }
        Split(series);
        FindLonely();
    }

    std::vector<Extreme> clear;
    std::vector<Extreme> doubtful;
    /// Of one digit ("-9", "-8.88"), where a series has hardly any other negative value.
    std::vector<Extreme> lonely;

    bool IsLonely(float value) const { return Holds(lonely, value); }

  private:
    /// Candidates are the outermost values as long as they look like codes. The innermost is judged
    /// first; one that is no code counts among the values that the next one is held against.
    void Split(const std::vector<float>& series) {
        const std::size_t lows = CountCandidates(low, IsLowCode);
        const std::size_t highs = CountCandidates(high, IsHighCode);
        Rest rest;
        for (const float value : series)
            if (value == value && !IsAmong(low, lows, value) && !IsAmong(high, highs, value))
                rest.Include(value);
        for (std::size_t i = lows; i-- > 0;)
            Judge(low.All()[i], IsClearLow(low.All()[i], rest, isFine), &rest);
        for (std::size_t i = highs; i-- > 0;)
            if (!IsAmong(low, lows, high.All()[i].value))
                Judge(high.All()[i], IsClearHigh(high.All()[i], rest), &rest);
    }
    void FindLonely() {
        constexpr std::size_t kFew = 2;
        std::size_t negatives = 0;
        for (const Extreme& extreme : low.All()) {
            if (extreme.value >= 0.0F || Holds(clear, extreme.value))
                continue;
            ++negatives;
            const std::string digits = DigitsOf(extreme.value);
            if (extreme.value <= -1.0F && IsRepeatedDigit(digits, digits.substr(0, 1), 1))
                lonely.push_back(extreme);
        }
        if (negatives > kFew)
            lonely.clear();
    }
    static bool Holds(const std::vector<Extreme>& list, float value) {
        return std::any_of(list.begin(), list.end(),
                           [value](const Extreme& known) { return known.value == value; });
    }
    void Judge(const Extreme& code, bool isClear, Rest* rest) {
        if (!isClear)
            rest->Include(code.value);
        (isClear ? clear : doubtful).push_back(code);
    }
    static std::size_t CountCandidates(const Extremes& extremes, bool (*isCode)(float)) {
        std::size_t count = 0;
        while (count < extremes.All().size() && isCode(extremes.All()[count].value))
            ++count;
        return count;
    }
    static bool IsAmong(const Extremes& extremes, std::size_t count, float value) {
        const auto end = extremes.All().begin() + static_cast<std::ptrdiff_t>(count);
        return std::any_of(extremes.All().begin(), end,
                           [value](const Extreme& code) { return code.value == value; });
    }

    Extremes low;
    Extremes high;
    bool isFine = false; ///< has values between whole numbers
};

long Replace(float code, std::vector<float>* series) {
    long count = 0;
    for (float& value : *series) {
        if (value == code) {
            value = kNoValue;
            ++count;
        }
    }
    return count;
}

/// Announced codes are taken whatever the other values are, and told even if they never occur.
void TakeAnnounced(const TableLayout& layout, const std::string& where, std::vector<float>* series,
                   ImportReport* report) {
    for (const AnnouncedCode& code : layout.announced) {
        const long count = Replace(code.value, series);
        report->missing.push_back({ShortestText(code.value), count,
                                   where + "announced in line " + std::to_string(code.line)});
    }
}

/// Worth a note: often, or written longer than a measurement is.
bool IsStriking(const Extreme& code) {
    return code.count >= 3 || DigitsOf(code.value).size() >= 4 || IsRoundedNines(code.value);
}

/// Values that look like codes stay, but the user is asked to look.
void NoteDoubtful(const Extreme& code, const std::string& column, ImportReport* report) {
    report->notes.push_back(ShortestText(code.value) + " occurs " +
                            (code.count == 1 ? "once" : std::to_string(code.count) + " times") +
                            " in column " + column +
                            " and is taken as a value; if it means missing, say --missing " +
                            ShortestText(code.value));
}

} // namespace

void TakeOutCodes(const TableLayout& layout, TableSamples* samples, ImportReport* report) {
    for (std::size_t i = 0; i < samples->values.size(); ++i) {
        std::vector<float>* series = &samples->values[i];
        // One item needs no word on which column it is.
        const std::string column = ColumnTitle(layout, layout.items[i]);
        const std::string where =
            samples->values.size() > 1 ? "in column " + column + ", " : std::string();
        TakeAnnounced(layout, where, series, report);
        const CodeSearch search(*series);
        for (const Extreme& code : search.clear)
            report->missing.push_back(
                {ShortestText(code.value), Replace(code.value, series),
                 where + "far from all other values; --missing none takes it as a value"});
        for (const Extreme& code : search.doubtful)
            if (IsStriking(code) && !search.IsLonely(code.value))
                NoteDoubtful(code, column, report);
        for (const Extreme& code : search.lonely)
            NoteDoubtful(code, column, report);
    }
}

void DropMissing(TableSamples* samples, ImportReport* report) {
    std::vector<std::size_t> kept;
    for (std::size_t i = 0; i < samples->Count(); ++i) {
        const bool isWhole =
            std::all_of(samples->values.begin(), samples->values.end(),
                        [i](const std::vector<float>& item) { return item[i] == item[i]; });
        if (isWhole)
            kept.push_back(i);
        else
            report->Dropped(DropReason::MissingValue).Add(samples->lines[i]);
    }
    if (kept.size() < samples->Count())
        samples->Keep(kept);
}

} // namespace ryn
