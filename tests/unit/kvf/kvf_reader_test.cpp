#include <limits>
#include <string>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "kvf/kvf.h"
#include "support/kvf_listing.h"

namespace ryn {
namespace {

using test::KvfErrorText;
using test::ListKvf;
using Lines = std::vector<std::string>;

const char* const kParameterFile = R"(# gauge "Nordhafen", 1950-2020
RynEditor {
    BasicInput {
        SelectionMethod = 0
        InputFileName = "gauge.tsq0"  # relative
        Threshold = 12.5
        InterTimeSpecified = true
        AmsStartDate = 1990, 1, 1,
            0, 0
    }
    Tsq2Input { Tsq2InputFile = file("C:\\waves.tq0") }
    DefineEVS {
        Title = "H\xF6he \"max\"\n", "Höhe"
        "odd name" =
    }
    ExtremeValueSection {
        ExtremeValues = 1.5f, -0.0f, 1e+20f
        SampleNo = inf, -inf, nan, nanf, 1e-310
    }
}
)";

TEST(KvfReader, ReadsEachKindOfValueAndItsSpellings) {
    const struct {
        const char* text;
        const char* expected;
    } cases[] = {
        {"0", "int 0"},
        {"-0", "int 0"},
        {"+007", "int 7"},
        {"2147483647", "int 2147483647"},
        {"-2147483648", "int -2147483648"},
        {"1.0", "double 4607182418800017408"},
        {"1.", "double 4607182418800017408"},
        {"+1e0", "double 4607182418800017408"},
        {"10E-1", "double 4607182418800017408"},
        {"-0.0", "double 9223372036854775808"},
        {"5e-324", "double 1"},
        {"1e-999", "double 0"},
        {"-.5f", "float 3204448256"},
        {"1f", "float 1065353216"},
        {"1e-45f", "float 1"},
        {"inf", "double 9218868437227405312"},
        {"-inf", "double 18442240474082181120"},
        {"nan", "double 9221120237041090560"},
        {"+inff", "float 2139095040"},
        {"-inff", "float 4286578688"},
        {"nanf", "float 2143289344"},
        {"true", "true"},
        {"false # so", "false"},
        {"\"\"", "text "},
        {"\"# {a} = \\\"b\\\\\\x41\\xe9\\t\"", "text # {a} = \"b\\A\xE9\t"},
        {"file ( \"a b.tq0\" )", "file a b.tq0"},
    };
    for (const auto& c : cases) {
        const KvfHandle tree = kvfLoadText("T{K=" + std::string(c.text) + "\n}", "case.ryn");
        const Lines expected{"section T", "keyword K of 1", c.expected, "end"};
        EXPECT_EQ(ListKvf(tree), expected) << c.text << ": " << KvfErrorText();
    }
}

TEST(KvfReader, TakesAnyLayoutThatTheGrammarAllows) {
    const Lines expected{"section A",
                         "keyword K of 0",
                         "keyword L of 2",
                         "int 1",
                         "int 2",
                         "section \"b c",
                         "end",
                         "end",
                         "section A",
                         "end"};
    const char* const texts[] = {
        "A {\n    K =\n    L = 1, 2\n    \"\\\"b c\" {\n    }\n}\nA {\n}\n",
        "A{K=#c\nL=1,2\n\"\\\"b c\"{}}A{}",
        ("\xEF\xBB\xBF# caf\xC3\xA9\r\nA {\r\n\tK = \r\n\tL = 1, # one\r\n\r\n# two\r\n2\r\n"
         "\"\\x22b c\" { } } A\t{ } # end"),
    };
    for (const char* text : texts) {
        const KvfHandle tree = kvfLoadText(text, "case.ryn");
        EXPECT_EQ(ListKvf(tree), expected) << text << KvfErrorText();
    }
    EXPECT_TRUE(kvfLoadText("", "empty.ryn"));
    EXPECT_TRUE(kvfLoadText(" \n# nothing", "comment.ryn"));
}

TEST(KvfReader, NamesFileLineColumnAndWhatWasExpected) {
    const char* const value = "a value (a number, true, false, \"...\" or file(\"...\")) after ";
    const struct {
        std::string text;
        std::string expected;
    } cases[] = {
        {"A {\n  K = yes\n}", "2:7: expected " + std::string(value) + "\"=\", found \"yes\""},
        {"A { K = 1, }", "1:12: expected " + std::string(value) + "\",\", found \"}\""},
        {"A { K = 1,\n\n  L = 2 }", "3:3: expected " + std::string(value) + "\",\", found \"L\""},
        {"A { K = , }", "1:9: expected " + std::string(value) + "\"=\", found \",\""},
        {"A { K = 0x1F\n}", "1:9: expected " + std::string(value) + "\"=\", found \"0x1F\""},
        {"A { K = 1e\n}", "1:9: expected " + std::string(value) + "\"=\", found \"1e\""},
        {"A { K = infinity\n}",
         "1:9: expected " + std::string(value) + "\"=\", found \"infinity\""},
        {"A { K = 1 2\n}", "1:11: expected \",\" or the end of the line, found \"2\""},
        {"A { K = 1 \"x\"\n}", "1:11: expected \",\" or the end of the line, found a quoted text"},
        {"A { K = \"\xC3\xA9\xE6\xB0\xB4\" ; }",
         "1:14: expected \",\" or the end of the line, found \";\""},
        {"A {\n\tK\n}", "2:3: expected \"=\" or \"{\" after the name, found the end of the line"},
        {"A { K-L = 1\n}", "1:6: expected \"=\" or \"{\" after the name, found \"-L\""},
        {"A { 1K = 1\n}", "1:5: expected a name or \"}\", found \"1K\""},
        {"K = 1", "1:3: expected \"{\" after the name of a block, found \"=\""},
        {"= 1", "1:1: expected the name of a block, found \"=\""},
        {"A { }\n}", "2:1: expected the name of a block (no block is open here), found \"}\""},
        {"A {\n  B {\n    K = 1\n\n",
         "5:1: expected \"}\" for the block \"B\" opened in line 2, found the end of the file"},
        {"A { K = \"open\n}",
         "1:14: expected a closing quote for the text that begins in column 9, found the end of "
         "the line"},
        {"A { K = \"open",
         "1:14: expected a closing quote for the text that begins in column 9, found the end of "
         "the file"},
        {"A { K = \"C:\\data\"\n}",
         "1:12: expected one of the escapes \\\" \\\\ \\n \\r \\t \\xHH (a backslash itself is "
         "\\\\), found \"\\d\""},
        {"A { K = \"\\x4\"\n}",
         "1:10: expected two hexadecimal digits after \\x, found \"\\x4\"\""},
        {"A { K = file\n}", "1:13: expected \"(\" after file, found the end of the line"},
        {"A { K = file(a)\n}", "1:14: expected a file name in quotes after \"file(\", found \"a\""},
        {"A { K = file(\"a\"\n}",
         "1:17: expected \")\" after the file name, found the end of the line"},
        {"A { K = 2147483648\n}",
         "1:9: expected an integer from -2147483648 to 2147483647 (beyond that with a decimal "
         "point), found \"2147483648\""},
        {"A { K = 0, 1e999\n}",
         "1:12: expected a number in the range of a double, found \"1e999\""},
        {"A { K = 1e39f\n}", "1:9: expected a number in the range of a float, found \"1e39f\""},
        {"A { \"" + std::string(100, 'x') + "\" 1 }",
         "1:108: expected \"=\" or \"{\" after the name, found \"1\""},
        {"A { " + std::string(100, 'x') + "\n",
         "1:105: expected \"=\" or \"{\" after the name, found the end of the line"},
        {std::string(100, 'x') + "{", "1:102: expected \"}\" for the block \"" +
                                          std::string(40, 'x') +
                                          "...\" opened in line 1, found the end of the file"},
    };
    for (const auto& c : cases) {
        EXPECT_FALSE(kvfLoadText(c.text, "case.ryn")) << c.text;
        EXPECT_EQ(KvfErrorText(), "case.ryn:" + c.expected) << c.text;
    }
}

TEST(KvfReader, RefusesBytesThatAreNoTextAnywhereInTheFile) {
    using std::string_literals::operator""s;
    const struct {
        std::string bytes;
        const char* found;
    } cases[] = {
        {"\0"s, "0x00"},          {"\x1B", "0x1B"},
        {"\x7F", "0x7F"},         {"\r", "0x0D"},
        {"\x80", "0x80"},         {"\xC3", "0xC3"},
        {"\xC0\x80", "0xC0"},     {"\xE0\x9F\xBF", "0xE0"},
        {"\xED\xA0\x80", "0xED"}, {"\xF4\x90\x80\x80", "0xF4"},
        {"\xFF\xFE", "0xFF"},
    };
    for (const auto& c : cases) {
        for (const char* place : {"\"", "#"}) {
            const std::string text = "A {\n \xC3\xA9" + c.bytes + "\" }" + place;
            EXPECT_FALSE(kvfLoadText(text, "case.ryn"));
            EXPECT_EQ(KvfErrorText(),
                      "case.ryn:2:3: expected UTF-8 text without control characters, found the "
                      "byte " +
                          std::string(c.found));
        }
    }
}

TEST(KvfReader, RefusesTooManyLevelsAndReadsTheLastOneAllowed) {
    const auto nested = [](int depth) {
        std::string text;
        for (int i = 0; i < depth; ++i)
            text += "A {\n";
        return text + std::string(static_cast<std::size_t>(depth), '}');
    };
    EXPECT_TRUE(kvfLoadText(nested(200), "deep.ryn"));
    for (const int depth : {201, 10000, 1000000}) {
        EXPECT_FALSE(kvfLoadText(nested(depth), "deep.ryn"));
        EXPECT_EQ(KvfErrorText(),
                  "deep.ryn:201:3: expected at most 200 levels of blocks, found \"{\"");
    }
}

TEST(KvfReader, ReadsOrRefusesAVeryLongLine) {
    std::string junk;
    junk.resize(20'000'000, 'x');
    const KvfHandle tree = kvfLoadText("A { K = \"" + junk + "\" }", "long.ryn");
    std::string value;
    EXPECT_NE(kvfGetParam(kvfTargetByNameNum(tree.get(), "A", 1), "K", &value, 1, 1), 0);
    EXPECT_TRUE(value == junk);
    EXPECT_FALSE(kvfLoadText("A { K = " + junk + " }", "long.ryn"));
    EXPECT_LT(KvfErrorText().size(), 300U);
    EXPECT_FALSE(kvfLoadText("A { K = \"" + junk, "long.ryn"));
    EXPECT_EQ(KvfErrorText().substr(0, 20), "long.ryn:1:20000010:");
}

/// Loads a text and checks that it gave a tree or a described error.
void ExpectTreeOrError(const std::string& text) {
    const KvfHandle tree = kvfLoadText(text, "changed.ryn");
    ASSERT_EQ(tree == nullptr, kvfPeekErrorGlb() != 0);
    if (tree) {
        const std::string written = kvfText(tree.get());
        ASSERT_EQ(kvfText(kvfLoadText(written, "again.ryn").get()), written) << text;
        return;
    }
    int line = 0;
    int column = 0;
    std::string error;
    kvfGetSyntaxErr(nullptr, &line, &column, &error);
    const std::string place =
        "changed.ryn:" + std::to_string(line) + ":" + std::to_string(column) + ": expected ";
    ASSERT_GT(line, 0);
    ASSERT_GT(column, 0);
    ASSERT_EQ(error.substr(0, place.size()), place);
}

TEST(KvfReader, ReadsOrRefusesAFileWithAnyByteChanged) {
    const std::string original = kParameterFile;
    ASSERT_TRUE(kvfLoadText(original, "good.ryn")) << KvfErrorText();
    const std::string replacements("\0\n\r \"\\{}=,#.(9-x\x7F\x80\xC3\xFF", 20);
    for (std::size_t i = 0; i < original.size(); ++i) {
        std::string changed = original;
        for (const char replacement : replacements) {
            changed[i] = replacement;
            ASSERT_NO_FATAL_FAILURE(ExpectTreeOrError(changed)) << "byte " << i;
        }
        changed[i] = static_cast<char>(original[i] ^ 0x20);
        ASSERT_NO_FATAL_FAILURE(ExpectTreeOrError(changed)) << "byte " << i;
    }
}

TEST(KvfReader, ReadsOrRefusesAFileCutOrGrownAtAnyLength) {
    const std::string original = kParameterFile;
    for (std::size_t i = 0; i < original.size(); ++i) {
        ASSERT_NO_FATAL_FAILURE(ExpectTreeOrError(original.substr(0, i)));
        ASSERT_NO_FATAL_FAILURE(ExpectTreeOrError(original.substr(i)));
        ASSERT_NO_FATAL_FAILURE(ExpectTreeOrError(original.substr(0, i) + original.substr(i / 2)));
    }
}

/// Random trees, built through the interface.
namespace build {

std::string AnyName() {
    return *rc::gen::oneOf(rc::gen::elementOf(std::vector<std::string>{"Item", "A_1", "", "1st"}),
                           rc::gen::container<std::string>(rc::gen::arbitrary<char>()));
}

template <typename Number>
Number AnyNumber() {
    using Limits = std::numeric_limits<Number>;
    return *rc::gen::oneOf(
        rc::gen::arbitrary<Number>(),
        rc::gen::elementOf(std::vector<Number>{
            -Number{0}, Number(0.1), Limits::denorm_min(), -Limits::min() / 3, Limits::max(),
            Limits::lowest(), Limits::infinity(), -Limits::infinity(), Limits::quiet_NaN(),
            Limits::epsilon(), Number(1e22), Number(123456789), -Number(1)}));
}

void AddKeyword(KvfTree* tree) {
    kvfAddKeyword(tree, AnyName());
    const int count = *rc::gen::inRange(0, 12);
    for (int i = 0; i < count; ++i) {
        switch (*rc::gen::inRange(0, 4)) {
        case 0:
            kvfAddInt(tree, *rc::gen::arbitrary<int>());
            break;
        case 1:
            kvfAddFloat(tree, AnyNumber<float>());
            break;
        case 2:
            kvfAddDouble(tree, AnyNumber<double>());
            break;
        default:
            kvfAddBool(tree, *rc::gen::arbitrary<bool>());
        }
    }
}

void AddPart(KvfTree* tree) {
    switch (*rc::gen::inRange(0, 6)) {
    case 0:
        kvfAddSection(tree, AnyName());
        break;
    case 1:
        kvfEndSection(tree);
        break;
    case 2:
        kvfAddTarget(tree, AnyName());
        break;
    case 3:
        kvfPutParam(tree, AnyName(), std::string_view(AnyName()));
        break;
    case 4:
        kvfPutParamFilename(tree, AnyName(), AnyName());
        break;
    default:
        AddKeyword(tree);
    }
}

} // namespace build

RC_GTEST_PROP(KvfTextProperty, AnyTreeSurvivesItsTextToTheBit, ()) {
    const KvfHandle tree = kvfCreate();
    const int parts = *rc::gen::inRange(0, 30);
    for (int i = 0; i < parts; ++i)
        build::AddPart(tree.get());
    const std::string text = kvfText(tree.get());
    const KvfHandle back = kvfLoadText(text, "random.ryn");
    RC_ASSERT(kvfPeekErrorGlb() == 0);
    RC_ASSERT(ListKvf(back) == ListKvf(tree));
    RC_ASSERT(kvfText(back.get()) == text);
}

TEST(KvfWriter, WrapsLongListsBeforeColumn100AndNeverAValue) {
    const KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), "A");
    kvfAddKeyword(tree.get(), "Values");
    for (int i = 0; i < 1000; ++i)
        kvfAddDouble(tree.get(), i / 7.0);
    kvfPutParam(tree.get(), "Long", std::string_view(std::string(300, 'x')));
    const std::string text = kvfText(tree.get());
    std::size_t start = 0;
    for (std::size_t end = 0; (end = text.find('\n', start)) != std::string::npos;
         start = end + 1) {
        const std::string line = text.substr(start, end - start);
        EXPECT_TRUE(line.size() <= 100 || line == "    Long = \"" + std::string(300, 'x') + "\"");
        EXPECT_NE(line.back(), ' ');
    }
    EXPECT_EQ(ListKvf(kvfLoadText(text, "wrapped.ryn")), ListKvf(tree));
}

} // namespace
} // namespace ryn
