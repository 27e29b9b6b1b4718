#include "kvf/text_reader.h"

#include <limits>
#include <string>
#include <vector>

#include "base/number_text.h"
#include "kvf/characters.h"
#include "kvf/tree.h"

namespace ryn {

namespace {

constexpr std::string_view kValueForms =
    "a value (a number, true, false, \"...\" or file(\"...\"))";

/// What a bare word is by its form. Its number may still be out of range.
enum class WordKind { Int, Float, Double, Other };

std::size_t CountDigits(std::string_view text) {
    std::size_t count = 0;
    while (count < text.size() && KvfIsDigit(text[count]))
        ++count;
    return count;
}

bool TakeSign(std::string_view* text) {
    if (text->empty() || (text->front() != '+' && text->front() != '-'))
        return false;
    text->remove_prefix(1);
    return true;
}

/// Moves over an exponent; false when its letter stands there without digits.
bool TakeExponent(std::string_view* text) {
    if (text->empty() || (text->front() != 'e' && text->front() != 'E'))
        return true;
    text->remove_prefix(1);
    TakeSign(text);
    const std::size_t digits = CountDigits(*text);
    text->remove_prefix(digits);
    return digits > 0;
}

WordKind Classify(std::string_view word) {
    TakeSign(&word);
    std::size_t digits = CountDigits(word);
    word.remove_prefix(digits);
    if (word.empty())
        return digits > 0 ? WordKind::Int : WordKind::Other;
    if (word.front() == '.') {
        const std::size_t decimals = CountDigits(word.substr(1));
        word.remove_prefix(1 + decimals);
        digits += decimals;
    }
    if (digits == 0 || !TakeExponent(&word))
        return WordKind::Other;
    if (word.empty())
        return WordKind::Double;
    return word == "f" ? WordKind::Float : WordKind::Other;
}

std::optional<KvfParam> NamedValue(std::string_view word) {
    constexpr double kInf = std::numeric_limits<double>::infinity();
    constexpr float kInfF = std::numeric_limits<float>::infinity();
    static const struct {
        std::string_view word;
        KvfParam value;
    } kNamed[] = {
        {"true", {true}},    {"false", {false}},
        {"inf", {kInf}},     {"+inf", {kInf}},
        {"-inf", {-kInf}},   {"nan", {std::numeric_limits<double>::quiet_NaN()}},
        {"inff", {kInfF}},   {"+inff", {kInfF}},
        {"-inff", {-kInfF}}, {"nanf", {std::numeric_limits<float>::quiet_NaN()}},
    };
    for (const auto& named : kNamed)
        if (named.word == word)
            return named.value;
    return std::nullopt;
}

template <typename Number>
std::optional<KvfParam> AsParam(std::optional<Number> number) {
    return number ? std::optional(KvfParam{*number}) : std::nullopt;
}

/// The value of a word with a number's form; nothing when it is beyond its type's range.
std::optional<KvfParam> NumberValue(std::string_view word, WordKind kind) {
    if (kind == WordKind::Int)
        return AsParam(ParseInt(word));
    if (kind == WordKind::Float)
        return AsParam(ParseFloat(word.substr(0, word.size() - 1)));
    return AsParam(ParseDouble(word));
}

std::string RangeText(WordKind kind) {
    if (kind == WordKind::Int)
        return "an integer from -2147483648 to 2147483647 (beyond that with a decimal point)";
    return kind == WordKind::Float ? "a number in the range of a float"
                                   : "a number in the range of a double";
}

/// One pass over the text that builds the tree. Functions return false after an error.
class Reader {
  public:
    Reader(std::string_view text, KvfTree* result) : scanner(text), tree(result) {}

    std::optional<KvfSyntaxError> Read() {
        if (scanner.CheckBytes())
            ReadBlocks();
        return scanner.Error();
    }

  private:
    struct Block {
        std::string name;
        int line;
    };

    bool ReadBlocks();
    bool ReadItem();
    bool ReadName(std::string_view* name);
    bool OpenBlock(std::string_view name, int line);
    bool CloseBlock();
    bool ReadKeyword(std::string_view name);
    bool ReadValue(char behind);
    bool ReadWord(std::string_view word, char behind);
    bool ReadFileName();

    KvfScanner scanner;
    KvfTree* tree;
    std::vector<Block> blocks; // the open ones
    std::string buffer;        // of a string
};

bool Reader::ReadBlocks() {
    for (scanner.SkipBlanksAndLines(); !scanner.AtEnd(); scanner.SkipBlanksAndLines())
        if (!ReadItem())
            return false;
    if (blocks.empty())
        return true;
    return scanner.Expected("\"}\" for the block " + KvfQuoteToken(blocks.back().name) +
                            " opened in line " + std::to_string(blocks.back().line));
}

/// The beginning of a block, its end, or a keyword.
bool Reader::ReadItem() {
    if (scanner.At('}'))
        return CloseBlock();
    std::string_view name;
    if (!ReadName(&name))
        return false;
    scanner.SkipBlanks();
    if (scanner.At('{'))
        return OpenBlock(name, scanner.Line());
    if (blocks.empty())
        return scanner.Expected("\"{\" after the name of a block");
    if (scanner.Take('='))
        return ReadKeyword(name);
    return scanner.Expected("\"=\" or \"{\" after the name");
}

/// The name is good until the next string is read.
bool Reader::ReadName(std::string_view* name) {
    if (scanner.At('"')) {
        if (!scanner.ReadString(&buffer))
            return false;
        *name = buffer;
        return true;
    }
    *name = scanner.TakeIdentifier();
    if (!name->empty())
        return true;
    return scanner.Expected(blocks.empty() ? "the name of a block" : "a name or \"}\"");
}

bool Reader::OpenBlock(std::string_view name, int line) {
    if (blocks.size() == kKvfMaxDepth)
        return scanner.Expected("at most " + std::to_string(kKvfMaxDepth) + " levels of blocks");
    scanner.Take('{');
    if (blocks.empty())
        kvfAddTarget(tree, name);
    else
        kvfAddSection(tree, name);
    blocks.push_back({std::string(name), line});
    return true;
}

bool Reader::CloseBlock() {
    if (blocks.empty())
        return scanner.Expected("the name of a block (no block is open here)");
    scanner.Take('}');
    kvfEndSection(tree);
    blocks.pop_back();
    return true;
}

bool Reader::ReadKeyword(std::string_view name) {
    kvfAddKeyword(tree, name);
    scanner.SkipBlanks();
    if (scanner.AtLineEnd() || scanner.At('#') || scanner.At('}'))
        return true;
    if (!ReadValue('='))
        return false;
    for (scanner.SkipBlanks(); scanner.Take(','); scanner.SkipBlanks()) {
        scanner.SkipBlanksAndLines();
        if (!ReadValue(','))
            return false;
    }
    if (scanner.AtLineEnd() || scanner.At('#') || scanner.At('}'))
        return true;
    return scanner.Expected("\",\" or the end of the line");
}

bool Reader::ReadValue(char behind) {
    if (scanner.At('"')) {
        if (!scanner.ReadString(&buffer))
            return false;
        tree->AppendParam(tree->openKeyword, {KvfText{tree->StoreText(buffer)}});
        return true;
    }
    return ReadWord(scanner.Word(), behind);
}

bool Reader::ReadWord(std::string_view word, char behind) {
    if (word == "file")
        return ReadFileName();
    const WordKind kind = Classify(word);
    const std::optional<KvfParam> value =
        kind == WordKind::Other ? NamedValue(word) : NumberValue(word, kind);
    if (value) {
        scanner.Skip(word);
        tree->AppendParam(tree->openKeyword, *value);
        return true;
    }
    if (kind != WordKind::Other)
        return scanner.Expected(RangeText(kind));
    return scanner.Expected(std::string(kValueForms) + " after \"" + behind + "\"");
}

bool Reader::ReadFileName() {
    scanner.Skip("file");
    scanner.SkipBlanks();
    if (!scanner.Take('('))
        return scanner.Expected("\"(\" after file");
    scanner.SkipBlanks();
    if (!scanner.At('"'))
        return scanner.Expected("a file name in quotes after \"file(\"");
    if (!scanner.ReadString(&buffer))
        return false;
    scanner.SkipBlanks();
    if (!scanner.Take(')'))
        return scanner.Expected("\")\" after the file name");
    tree->AppendParam(tree->openKeyword, {KvfFileName{tree->StoreText(buffer)}});
    return true;
}

} // namespace

std::optional<KvfSyntaxError> KvfReadText(std::string_view text, KvfTree* tree) {
    return Reader(text, tree).Read();
}

} // namespace ryn
