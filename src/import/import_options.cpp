#include "import/import_options.h"

#include "import/number_field.h"
#include "import/table_text.h"

namespace ryn {

namespace {

/// One line that names the option, what was given, and what it may be.
Status Unknown(const std::string& option, const std::string& value, const std::string& allowed) {
    return Status::InputFault("--" + option + " " + Quoted(value) + ": " + allowed);
}

Status ParseDelimiter(const std::string& text, std::optional<char>* delimiter) {
    struct Name {
        std::string_view name;
        char character;
    };
    constexpr Name kNames[] = {{"comma", ','}, {"semicolon", ';'}, {"tab", '\t'},  {"\\t", '\t'},
                               {"bar", '|'},   {"pipe", '|'},      {"blank", ' '}, {"blanks", ' '},
                               {"space", ' '}, {"spaces", ' '}};
    if (text.empty())
        return Status::Ok();
    for (const Name& known : kNames)
        if (Lowercase(text) == known.name)
            *delimiter = known.character;
    if (text.size() == 1)
        *delimiter = text[0];
    // A letter or a digit would cut numbers and names, and the quote has its own meaning. Several
    // characters that name nothing leave the delimiter open, and come here as a quote.
    const char c = delimiter->value_or('"');
    if (c == '"' || IsDigit(c) || IsLetter(c) ||
        (static_cast<unsigned char>(c) < 0x20 && c != '\t'))
        return Unknown("delimiter", text,
                       "one character that is no letter and no digit, or comma, semicolon, tab, "
                       "bar, blank");
    return Status::Ok();
}

Status ParseDecimal(const std::string& text, std::optional<char>* decimal) {
    if (text.empty())
        return Status::Ok();
    if (text != "." && text != "," && text != "point" && text != "comma")
        return Unknown("decimal", text, "\".\" or \",\"");
    *decimal = text == "," || text == "comma" ? ',' : '.';
    return Status::Ok();
}

/// Words for the forms that no pattern can express; everything else is a pattern.
Status ParseTimeFormat(const std::string& text, ImportSettings* settings) {
    struct Name {
        std::string_view name;
        DateForm form;
    };
    constexpr Name kNames[] = {{"excel", DateForm::ExcelSerial},
                               {"unix", DateForm::UnixSeconds},
                               {"decimal-year", DateForm::DecimalYear},
                               {"year", DateForm::Year}};
    if (text.empty())
        return Status::Ok();
    for (const Name& known : kNames) {
        if (Lowercase(text) == known.name) {
            settings->dateForm = known.form;
            return Status::Ok();
        }
    }
    TimePattern pattern;
    std::string reason;
    if (!TimePattern::Compile(text, &pattern, &reason))
        return Unknown("time-format", text,
                       reason + "; use fields such as %Y-%m-%d %H:%M, or excel, unix, "
                                "decimal-year, year");
    settings->pattern = pattern;
    return Status::Ok();
}

/// The one date that is typed by hand is read in one form, so that it cannot be misread.
Status ParseStart(const std::string& text, std::optional<Millis>* start) {
    if (text.empty())
        return Status::Ok();
    TimeParts parts;
    Millis moment = 0;
    if (ParseDate(Trimmed(text), DateForm::YearMonthDay, &parts) != TimeResult::Ok ||
        MomentOf(parts, {}, &moment) != TimeResult::Ok)
        return Unknown("start", text, "a date such as 1914-01-01 or \"1914-01-01 06:00\"");
    *start = moment;
    return Status::Ok();
}

Status ParseStep(const std::string& text, ImportSettings* settings) {
    if (text.empty())
        return Status::Ok();
    settings->step = ParseTimeStep(text);
    if (!settings->step)
        return Unknown("step", text,
                       "a length of time such as 1d, 1h, 10min, 1mo, 1y or a number of seconds");
    if (!settings->start)
        return Status::InputFault("--step needs --start: the date of the first row");
    return Status::Ok();
}

Status ParseDuplicates(const std::string& text, DuplicateRule* rule) {
    struct Name {
        std::string_view name;
        DuplicateRule rule;
    };
    constexpr Name kNames[] = {{"refuse", DuplicateRule::Refuse},
                               {"", DuplicateRule::Refuse},
                               {"first", DuplicateRule::First},
                               {"last", DuplicateRule::Last},
                               {"max", DuplicateRule::Maximum}};
    for (const Name& known : kNames) {
        if (text == known.name) {
            *rule = known.rule;
            return Status::Ok();
        }
    }
    return Unknown("duplicates", text, "refuse, first, last or max");
}

/// Empty codes count: a user says with "" that blank lines are missing values.
void ParseMissing(const std::vector<std::string>& codes, MissingRules* rules) {
    // Who gives codes knows them: looking for others as well could take away values.
    rules->searchCodes = codes.empty();
    for (const std::string& code : codes) {
        const std::string text(Trimmed(code));
        if (codes.size() == 1 && Lowercase(text) == "none")
            continue;
        rules->texts.push_back(text);
        // A code that is a number is compared as one, so that -9999 finds "-9999.000000" too.
        const NumberField number = ReadNumber(text, '.');
        if (number.kind == NumberKind::Value)
            rules->numbers.push_back(number.value);
    }
}

Status ParseEncoding(const std::string& text, std::optional<TextEncoding>* encoding) {
    if (text.empty())
        return Status::Ok();
    *encoding = EncodingOfName(text);
    return *encoding
               ? Status::Ok()
               : Unknown("encoding", text,
                         "utf-8, latin-1, windows-1252, utf-16le, utf-16be, shift_jis or euc-jp");
}

} // namespace

/// The settings are taken over only when every option is understood.
Status ParseImportOptions(const ImportOptions& options, ImportSettings* settings) {
    ImportSettings parsed;
    parsed.timeColumns = options.timeColumns;
    parsed.itemColumns = options.itemColumns;
    parsed.unit = options.unit;
    parsed.name = options.name;
    parsed.skipLines = options.skipLines > 0 ? options.skipLines : 0;
    parsed.order = options.sort ? RowOrder::Any : RowOrder::MustRise;
    if (!options.comment.empty())
        parsed.commentMarks.push_back(options.comment);
    ParseMissing(options.missing, &parsed.missing);
    if (options.itemColumns.size() > 1 && !options.name.empty())
        return Status::InputFault("--name names one item, and there are several --item");
    Status status = ParseDelimiter(options.delimiter, &parsed.delimiter);
    if (status)
        status = ParseDecimal(options.decimal, &parsed.decimal);
    if (status)
        status = ParseEncoding(options.encoding, &parsed.encoding);
    if (status)
        status = ParseTimeFormat(options.timeFormat, &parsed);
    if (status)
        status = ParseStart(options.start, &parsed.start);
    if (status)
        status = ParseStep(options.step, &parsed);
    if (status)
        status = ParseDuplicates(options.duplicates, &parsed.duplicates);
    if (status)
        *settings = std::move(parsed);
    return status;
}

} // namespace ryn
