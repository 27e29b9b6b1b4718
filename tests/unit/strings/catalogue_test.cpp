#include "strings/catalogue.h"

#include <clocale>
#include <regex>
#include <vector>

#include <gtest/gtest.h>

#include "strings/language.h"

namespace ryn {
namespace {

/// The language of a scope.
class LanguageScope {
  public:
    explicit LanguageScope(Language language) : previous(CurrentLanguage()) {
        SetLanguage(language);
    }
    ~LanguageScope() { SetLanguage(previous); }
    LanguageScope(const LanguageScope&) = delete;
    LanguageScope& operator=(const LanguageScope&) = delete;

  private:
    Language previous;
};

std::string TextIn(Language language, int id) {
    const LanguageScope scope(language);
    return std::string(Text(id));
}

std::vector<std::string> PlacesOf(const std::string& text) {
    static const std::regex place("%[-+ #0]*[0-9]*(\\.[0-9]+)?[a-zA-Z%]");
    return {std::sregex_token_iterator(text.begin(), text.end(), place),
            std::sregex_token_iterator()};
}

TEST(Catalogue, HasTheSamePlacesToFillInBothLanguages) {
    int texts = 0;
    for (int id = 3000; id < 101000; ++id) {
        const std::string english = TextIn(Language::English, id);
        const std::string japanese = TextIn(Language::Japanese, id);
        EXPECT_EQ(english.empty(), japanese.empty()) << id;
        EXPECT_EQ(PlacesOf(english), PlacesOf(japanese)) << id;
        texts += english.empty() ? 0 : 1;
    }
    EXPECT_GT(texts, 50);
}

TEST(Catalogue, KeepsTheSystemsOwnTextsToTheLetter) {
    EXPECT_EQ(TextIn(Language::English, 3989), "Can not open input file ");
    EXPECT_EQ(TextIn(Language::English, 3975),
              "Number of extracted peak values is smaller than requiered. Parameters were changed "
              "to fit results.");
    EXPECT_EQ(TextIn(Language::English, 3967), "Independence and homogenity tests");
    EXPECT_EQ(TextIn(Language::English, 42112),
              "File was not saved recently. Do you want to save it ?");
}

TEST(Catalogue, GivesNothingForAnUnknownId) {
    EXPECT_EQ(Text(0), "");
    EXPECT_EQ(Text(-1), "");
    EXPECT_EQ(FormatText(1, 2.0), "");
}

TEST(Catalogue, GivesSingleLinesOfATextOfSeveral) {
    EXPECT_EQ(TextLine(kTextExponentialAndTruncatedGumbel, 0), "Exponential");
    EXPECT_EQ(TextLine(kTextExponentialAndTruncatedGumbel, 1), "Truncated Gumbel");
    EXPECT_EQ(TextLine(kTextExponentialAndTruncatedGumbel, 2), "");
    EXPECT_EQ(TextLine(kTextDocumentTemplate, 4), ".ryn");
}

TEST(Catalogue, FillsInNumbersWithADecimalPointWhateverTheLocale) {
    ASSERT_NE(std::setlocale(LC_ALL, "de_DE.UTF-8"), nullptr);
    EXPECT_EQ(FormatText(kTextThresholdBelowMaximum, 12.5),
              "Threshold must be smaller than 12.500");
    std::setlocale(LC_ALL, "C");
}

TEST(Language, FollowsTheNameOfALocale) {
    EXPECT_EQ(LanguageOfLocale("ja_JP.UTF-8"), Language::Japanese);
    EXPECT_EQ(LanguageOfLocale("ja"), Language::Japanese);
    for (const char* name : {"", "C", "en_US.UTF-8", "jav_ID", "de_DE@euro"})
        EXPECT_EQ(LanguageOfLocale(name), Language::English) << name;
}

} // namespace
} // namespace ryn
