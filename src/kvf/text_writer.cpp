#include "kvf/text_writer.h"

#include <algorithm>
#include <utility>

#include "base/number_text.h"
#include "kvf/characters.h"
#include "kvf/tree.h"

namespace ryn {

namespace {

constexpr std::size_t kLineWidth = 100;
constexpr std::size_t kIndent = 4;

std::string Escaped(char byte) {
    switch (byte) {
    case '\n':
        return "\\n";
    case '\r':
        return "\\r";
    case '\t':
        return "\\t";
    case '"':
    case '\\':
        return {'\\', byte};
    default:
        return "\\x" + KvfHexByte(byte);
    }
}

bool NeedsEscape(char c) {
    return KvfIsControl(c) || c == '"' || c == '\\';
}

void AppendQuoted(std::string_view bytes, std::string* text) {
    *text += '"';
    for (std::size_t i = 0; i < bytes.size();) {
        const std::size_t length = KvfUtf8Length(bytes, i);
        if (length == 0 || NeedsEscape(bytes[i]))
            *text += Escaped(bytes[i]);
        else
            *text += bytes.substr(i, length);
        i += std::max<std::size_t>(length, 1);
    }
    *text += '"';
}

bool IsIdentifier(std::string_view name) {
    return !name.empty() && KvfIsLetter(name.front()) &&
           std::all_of(name.begin(), name.end(), KvfIsLetterOrDigit);
}

void AppendName(std::string_view name, std::string* text) {
    if (IsIdentifier(name))
        *text += name;
    else
        AppendQuoted(name, text);
}

/// A number's text made to look like no int: "3.0" for "3".
std::string AsReal(std::string digits) {
    if (digits.find_first_of(".en") == std::string::npos) // exponent, inf or nan
        digits += ".0";
    return digits;
}

struct ValueText {
    std::string operator()(int value) const { return std::to_string(value); }
    std::string operator()(float value) const { return AsReal(ShortestText(value)) + "f"; }
    std::string operator()(double value) const { return AsReal(ShortestText(value)); }
    std::string operator()(bool value) const { return value ? "true" : "false"; }
    std::string operator()(KvfText value) const {
        std::string text;
        AppendQuoted(*value.text, &text);
        return text;
    }
    std::string operator()(KvfFileName value) const {
        std::string text = "file(";
        AppendQuoted(*value.text, &text);
        return text + ")";
    }
};

} // namespace

void KvfTextWriter::BeginSection(std::string_view name) {
    Indent(depth);
    AppendName(name, &text);
    text += " {\n";
    deepest = std::max(deepest, ++depth);
}

void KvfTextWriter::EndSection() {
    Indent(--depth);
    text += "}\n";
}

void KvfTextWriter::BeginKeyword(std::string_view name, int) {
    Indent(depth);
    AppendName(name, &text);
    text += " =";
    isFirstParameter = true;
}

void KvfTextWriter::Parameter(const KvfParam& parameter) {
    const std::string value = std::visit(ValueText(), parameter.value);
    if (!std::exchange(isFirstParameter, false)) {
        text += ',';
        // The blank before and the comma behind count too.
        if (text.size() - lineStart + value.size() + 2 > kLineWidth) {
            text += '\n';
            Indent(depth + 1);
            text += value;
            return;
        }
    }
    text += ' ';
    text += value;
}

void KvfTextWriter::EndKeyword() {
    text += '\n';
}

void KvfTextWriter::Indent(std::size_t level) {
    lineStart = text.size();
    // A file has no deeper levels; a tree built by calls may, and its text stays proportional.
    text.append(std::min(level, kKvfMaxDepth) * kIndent, ' ');
}

std::string kvfText(const KvfTree* tree) {
    KvfTextWriter writer;
    kvfVisit(tree, writer);
    return writer.TakeText();
}

} // namespace ryn
