#include "command_fixture.h"
#include "strings/language.h"

namespace ryn::cli {
namespace {

struct BadCommandLine {
    std::string name;
    std::vector<std::string> arguments;
    int code;
    std::string line; ///< the whole of standard error; "*" stands for any text
};

/// One line that the pattern describes.
bool IsLineLike(const std::string& text, std::string_view pattern) {
    std::size_t place = 0;
    bool anyBefore = false;
    while (!pattern.empty()) {
        const std::string_view part = pattern.substr(0, pattern.find('*'));
        const std::size_t found = text.find(part, place);
        if (found == std::string::npos || (!anyBefore && found != place))
            return false;
        place = found + part.size();
        anyBefore = part.size() < pattern.size();
        pattern.remove_prefix(part.size() + (anyBefore ? 1 : 0));
    }
    return (anyBefore || place == text.size()) && text.find('\n') + 1 == text.size();
}

class BadCommandLines : public CommandTest, public testing::WithParamInterface<BadCommandLine> {};

TEST_P(BadCommandLines, AreAnsweredInOneLine) {
    WriteYearly("s.tsq0", {1, 2, 3, 4, 5, 6});
    files.Write("broken.ryn", "RynEditor {");
    files.Write("empty.ryn", "");
    files.Write("text.txt", "1\n2\nthree\n");
    ASSERT_EQ(Run({"new", "case.ryn"}), 0);
    const std::string saved = files.Read("case.RYN");
    EXPECT_EQ(Run(GetParam().arguments), GetParam().code);
    SetLanguage(Language::English);
    EXPECT_TRUE(IsLineLike(err, GetParam().line)) << err;
    EXPECT_EQ(out, "");
    EXPECT_EQ(files.Read("case.RYN"), saved);
    EXPECT_EQ(files.Read("broken.ryn"), "RynEditor {");
    EXPECT_EQ(files.EntryCount(), 5U);
}

const BadCommandLine kCommands[] = {
    {"NoCommand",
     {},
     1,
     "ryn: no command is given; there are: import, export, info, new, set, check, extract, run, "
     "show, grid, fit, selfcheck (ryn --help tells the usage)\n"},
    {"UnknownCommand", {"exprt", "s.tsq0"}, 1, "ryn: unknown command exprt; nearest: export\n"},
    {"OptionsWithoutCommand", {"--lang", "en"}, 1, "ryn: no command is given; there are: *"},
    {"UnknownOption",
     {"check", "case.ryn", "--jsn"},
     1,
     "ryn: not expected: --jsn; nearest: --json (ryn check --help tells the usage)\n"},
    {"UnknownOptionBeforeTheCommand",
     {"--verbose"},
     1,
     "ryn: not expected: --verbose (ryn --help tells the usage)\n"},
    {"TooManyArguments",
     {"check", "case.ryn", "b", "c"},
     1,
     "ryn: not expected: b c (ryn check --help tells the usage)\n"},
    {"MissingArgument",
     {"check"},
     1,
     "ryn: CASE.ryn is missing (ryn check --help tells the usage)\n"},
    {"MissingValue",
     {"export", "s.tsq0", "--item"},
     1,
     "ryn: --item: its value is missing (ryn export --help tells the usage)\n"},
    {"OptionGivenTwice",
     {"export", "s.tsq0", "--item", "1", "--item", "1"},
     1,
     "ryn: --item: may be given only once (ryn export --help tells the usage)\n"},
    {"ValueThatIsNone",
     {"show", "case.ryn", "--page", "x"},
     1,
     "ryn: --page: \"x\" is no valid value (ryn show --help tells the usage)\n"},
    {"InJapanese",
     {"check", "--lang", "ja"},
     1,
     "ryn: CASE.ryn がありません（使い方: ryn check --help）\n"},
    {"UnknownLanguage",
     {"check", "case.ryn", "--lang", "fr"},
     1,
     "ryn: --lang: \"fr\" is no valid value; expected: en, ja (ryn check --help tells the "
     "usage)\n"},
    {"ItemThatIsNoNumber",
     {"export", "s.tsq0", "--item", "1.5"},
     1,
     "ryn: --item: \"1.5\" is no valid value; expected: a whole number (ryn export --help tells "
     "the usage)\n"},
    {"UncertaintyThatIsNone",
     {"fit", "GP/LMOM", "text.txt", "--uncertainty", "bootstrap"},
     1,
     "ryn: --uncertainty: \"bootstrap\" is no valid value; expected: none, montecarlo, jackknife "
     "(ryn fit --help tells the usage)\n"},
    {"PlottingPositionsThatAreNone",
     {"fit", "GP/LMOM", "text.txt", "--plotting", "5"},
     1,
     "ryn: --plotting: \"5\" is no valid value; expected: 0 Weibull, 1 Hazen, 2 Gringorten, 3 "
     "Blom, 4 Cunnane (ryn fit --help tells the usage)\n"},
    {"NameGivenTwice",
     {"fit", "GP/LMOM,GEV/ML,gp/lmom", "text.txt"},
     1,
     "ryn: GP/LMOM is named twice\n"},
    {"EmptyName",
     {"fit", "GP/LMOM,", "text.txt"},
     1,
     "ryn: NAME: \"GP/LMOM,\" is no valid value; expected: names with commas between them, or "
     "all\n"},
    {"NoName",
     {"fit", "", "text.txt"},
     1,
     "ryn: NAME: \"\" is no valid value; expected: names with commas between them, or all\n"},
    {"AllAmongOthers",
     {"fit", "all,GP/LMOM", "text.txt"},
     1,
     "ryn: unknown combination all; on offer for annual maximum series: *"},
    {"CorrectionThatNoneKnows",
     {"fit", "GUM/ML,GEV/MOM", "text.txt", "--sample-correction"},
     1,
     "ryn: --sample-correction is for GUM/MOM, which is not among the combinations\n"},
    {"RateThatIsNoNumber",
     {"fit", "GP2/LMOM", "text.txt", "--pds", "--threshold", "1", "--rate", "2,5"},
     1,
     "ryn: --rate: \"2,5\" is no valid value; expected: a number with a decimal point (ryn fit "
     "--help tells the usage)\n"},
};

const BadCommandLine kFiles[] = {
    {"NoSuchParameterFile", {"check", "no.ryn"}, 1, "ryn: no.ryn: No such file or directory\n"},
    {"OtherExtension",
     {"check", "case.Ryn"},
     1,
     "ryn: case.Ryn: the name of a parameter file ends in .ryn or .RYN\n"},
    {"NewWithOtherExtension",
     {"new", "case.txt"},
     1,
     "ryn: case.txt: the name of a parameter file ends in .ryn or .RYN\n"},
    {"NewOverExisting",
     {"new", "case.RYN"},
     1,
     "ryn: case.RYN: exists already; --yes replaces it\n"},
    {"NewOverTheOtherSpelling",
     {"new", "case.ryn"},
     1,
     "ryn: case.RYN: exists already; --yes replaces it\n"},
    {"NewInNoDirectory",
     {"new", "no/case.ryn"},
     3,
     "ryn: */no/case.RYN: No such file or directory\n"},
    {"SetOfBrokenFile", {"set", "broken.ryn", "DefineEVS.Title=x"}, 1, "*broken.ryn:1:12: *"},
    {"SetOfFileWithoutTarget",
     {"set", "empty.ryn", "DefineEVS.Title=x"},
     1,
     "ryn: empty.ryn: is no parameter file: it has no target RynEditor\n"},
    {"NothingToSet",
     {"set", "case.ryn"},
     1,
     "ryn: set: there is nothing to set; give Section.Keyword=value, --fit or --periods\n"},
    {"InfoOfDirectory", {"info", "."}, 1, "ryn: .: not a regular file\n"},
    {"ExportOfText", {"export", "text.txt"}, 1, "ryn: text.txt: no netCDF file\n"},
    {"ExportOfNoItem",
     {"export", "s.tsq0", "--item", "2"},
     1,
     "ryn: s.tsq0: there is no item 2; the file has 1\n"},
    {"ExportOverExisting",
     {"export", "s.tsq0", "-o", "text.txt"},
     1,
     "ryn: text.txt: exists already; --yes replaces it\n"},
    {"ExportOverItsInput",
     {"export", "s.tsq0", "-o", "./s.tsq0", "--yes"},
     1,
     "ryn: ./s.tsq0: is the input file itself; choose another output file\n"},
    {"ExportToDevice",
     {"export", "s.tsq0", "-o", "/dev/full"},
     3,
     "ryn: /dev/full: not a regular file\n"},
    {"ExportToNoDirectory",
     {"export", "s.tsq0", "-o", "no/t.csv"},
     3,
     "ryn: no/t.csv: No such file or directory\n"},
    {"ExtractWithoutFiles",
     {"extract", "case.ryn"},
     1,
     "ryn: case.RYN: Can not execute extraction - filename is missing\n"},
    {"ImportOverExisting",
     {"import", "text.txt", "s.tsq0"},
     1,
     "ryn: s.tsq0: exists already; --yes replaces it\n"},
    {"ImportOverItsInput",
     {"import", "text.txt", "text.txt", "--yes"},
     1,
     "ryn: text.txt: is the input file itself; choose another output file\n"},
};

const BadCommandLine kValues[] = {
    {"NoAssignment",
     {"set", "case.ryn", "Threshold"},
     1,
     "ryn: Threshold: expected Section.Keyword=value\n"},
    {"UnknownSection",
     {"set", "case.ryn", "Basicinput.Threshold=1"},
     1,
     "ryn: unknown section Basicinput; nearest: BasicInput\n"},
    {"UnknownKeyword",
     {"set", "case.ryn", "BasicInput.Treshold=1"},
     1,
     "ryn: unknown keyword BasicInput.Treshold; nearest: BasicInput.Threshold\n"},
    {"BadNumber",
     {"set", "case.ryn", "BasicInput.Threshold=12,5"},
     1,
     "ryn: BasicInput.Threshold: \"12,5\" is no valid value; expected: a number with a decimal "
     "point\n"},
    {"BadChoice",
     {"set", "case.ryn", "BasicInput.SelectionMethod=2"},
     1,
     "ryn: BasicInput.SelectionMethod: \"2\" is no valid value; expected: 0 (AMS), 1 (PDS)\n"},
    {"BadDate",
     {"set", "case.ryn", "BasicInput.AmsStartDate=2001-02-30"},
     1,
     "ryn: BasicInput.AmsStartDate: \"2001-02-30\" is no valid value; expected: a date as "
     "YYYY-MM-DD, YYYY-MM-DDTHH:MM or MM-DD\n"},
    {"BadPeriods",
     {"set", "case.ryn", "--periods", "2,,10"},
     1,
     "ryn: --periods: \"2,,10\" is no valid value; expected: numbers with commas between them\n"},
    {"PeriodThatIsNeverRight",
     {"new", "case.ryn", "--yes", "--periods", "10,0"},
     1,
     "ryn: return period 0 must be greater than 0 years\n"},
    {"PeriodSetBelowZero",
     {"set", "case.ryn", "Analysis.EvaluatedReturnPeriods.Item=-2.5"},
     1,
     "ryn: return period -2.5 must be greater than 0 years\n"},
    {"PeriodThatIsNotFinite",
     {"set", "case.ryn", "--periods", "inf"},
     1,
     "ryn: --periods: \"inf\" is no valid value; expected: numbers with commas between them\n"},
    {"GoodThenBad",
     {"set", "case.ryn", "DefineEVS.Title=x", "DefineEVS.Threshold=y"},
     1,
     "ryn: DefineEVS.Threshold: \"y\" is no valid value; expected: a number with a decimal "
     "point\n"},
    {"ControlCharacters",
     {"set", "case.ryn", "BasicInput.Threshold=\x1b[31m\nx"},
     1,
     "ryn: BasicInput.Threshold: \"\\x1b[31m x\" is no valid value; expected: a number with a "
     "decimal point\n"},
    {"CombinationOfTheOtherKind",
     {"set", "case.ryn", "--fit", "GP2/ML"},
     1,
     "*GP2/ML is a name for partial duration series, but this is one of annual maximum series "
     "(DefineEVS.SelectionMethod decides); on offer: GEV/MOM, *"},
    {"UnknownCombination",
     {"set", "case.ryn", "DefineEVS.SelectionMethod=PDS", "--fit", "GEW/MOM"},
     1,
     "*unknown combination GEW/MOM; on offer for partial duration series: WEI2/MOM, *"},
    {"ColumnWithText",
     {"fit", "GEV/LMOM", "text.txt"},
     1,
     "ryn: text.txt: line 3: \"three\" is no number\n"},
    {"PeriodTooSmall",
     {"fit", "GEV/LMOM", "s.tsq0", "--periods", "10,1"},
     1,
     "ryn: return period 1 must be greater than 1 years\n"},
    {"RateWithoutPds",
     {"fit", "GEV/LMOM", "s.tsq0", "--rate", "2"},
     1,
     "ryn: --rate and --threshold belong to a partial duration series; add --pds\n"},
    {"PdsWithoutRate",
     {"fit", "GP2/LMOM", "s.tsq0", "--pds"},
     1,
     "ryn: --pds needs --rate (events a year, greater than 0) and --threshold\n"},
};

std::string NameOf(const testing::TestParamInfo<BadCommandLine>& info) {
    return info.param.name;
}

INSTANTIATE_TEST_SUITE_P(Commands, BadCommandLines, testing::ValuesIn(kCommands), NameOf);
INSTANTIATE_TEST_SUITE_P(Files, BadCommandLines, testing::ValuesIn(kFiles), NameOf);
INSTANTIATE_TEST_SUITE_P(Values, BadCommandLines, testing::ValuesIn(kValues), NameOf);

} // namespace
} // namespace ryn::cli
