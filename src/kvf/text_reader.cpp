#include "kvf/text_reader.h"

#include <string>
#include <vector>

#include "kvf/tree.h"
#include "kvf/word_value.h"

namespace ryn {

namespace {

constexpr std::string_view kValueForms =
    "a value (a number, true, false, \"...\" or file(\"...\"))";

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
    const KvfWord read = KvfReadWord(word);
    if (read.value) {
        scanner.Skip(word);
        tree->AppendParam(tree->openKeyword, *read.value);
        return true;
    }
    if (!read.range.empty())
        return scanner.Expected(std::string(read.range));
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
