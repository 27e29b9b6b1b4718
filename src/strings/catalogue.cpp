#include "strings/catalogue.h"

#include <algorithm>
#include <array>

#include "strings/language.h"

namespace ryn {

namespace {

struct Entry {
    int id;
    std::string_view english;
    std::string_view japanese;
};

// In ascending order of id, which the lookup relies on.
constexpr std::array kEntries = std::to_array<Entry>({
    {kTextGeneralizedExtremeValue, "Generalized Extreme Value", "一般化極値分布"},
    {kTextGumbel, "Gumbel", "グンベル分布"},
    {kTextWeibull, "Weibull", "ワイブル分布"},
    {kTextFrechet, "Frechet", "フレシェ分布"},
    {kTextGeneralisedPareto, "Generalised Pareto", "一般化パレート分布"},
    {kTextGammaPearson3, "Gamma/Pearson Type 3", "ガンマ／ピアソンIII型分布"},
    {kTextLogPearson3, "Log-Pearson Type 3", "対数ピアソンIII型分布"},
    {kTextLogNormal, "Log-normal", "対数正規分布"},
    {kTextSquareRootExponential, "Square-root Exponential", "平方根指数型最大値分布"},
    {kTextParameterFileFilter, "RYN editor files (*.ryn)|*.ryn||",
     "RYN エディタファイル (*.ryn)|*.ryn||"},
    {kTextDataFileFilter, "Tsq files (*.tsq0;*.tq0)|*.tsq0; *.tq0|All Files (*.*)|*.*||",
     "Tsq ファイル (*.tsq0;*.tq0)|*.tsq0; *.tq0|すべてのファイル (*.*)|*.*||"},
    {kTextResultFileFilter, "RYN result file (*.res)|*.res||",
     "RYN 結果ファイル (*.res)|*.res||"},
    {kTextPageExtract, "Extract Extreme Value Series", "極値系列の抽出"},
    {kTextPageDefine, "Define Extreme Value Series", "極値系列の定義"},
    {kTextPageAnalysis, "Analysis", "解析"},
    {kTextPageDistributions, "Probability Distribution and Estimation Method",
     "確率分布と母数推定法"},
    {kTextPagePlottingPositions, "Extreme value series and plotting position",
     "極値系列とプロッティングポジション"},
    {kTextPageIndependence, "Independence and homogenity tests", "独立性と均質性の検定"},
    {kTextPageGoodnessOfFit, "Goodness-of-fit statistics", "適合度の統計量"},
    {kTextPageSampleStatistics, "Sample statistics and estimated parameters",
     "標本統計量と推定母数"},
    {kTextDocumentTemplate,
     "ryn.chm\nRYNEdit\nRYN Editor\nRYN Editor File (*.ryn)\n.ryn\nRynEdit.Document\n"
     "Extreme Value Analysis",
     "ryn.chm\nRYNEdit\nRYN エディタ\nRYN エディタファイル (*.ryn)\n.ryn\nRynEdit.Document\n"
     "Extreme Value Analysis"},
    {kTextPeaksFewerThanRequired,
     "Number of extracted peak values is smaller than requiered. Parameters were changed to fit "
     "results.",
     "抽出されたピーク値の数が指定より少なくなりました。パラメータを結果に合わせて変更しました。"},
    {kTextPageQuantiles, "Estimated quantiles and standard errors", "確率水文量と標準誤差"},
    {kTextPageHistogram, "Histogram and frequency function", "ヒストグラムと頻度関数"},
    {kTextPageFrequencyPlot, "Frequency plot", "頻度図"},
    {kTextPageProbabilityPlot, "Probability plot", "確率図"},
    {kTextApplicationName, "RYN Editor", "RYN エディタ"},
    {kTextUnsupportedFileFormat, "Unsupported file format",
     "サポートされていないファイル形式です"},
    {kTextCannotOpenInputFile, "Can not open input file ", "入力ファイルを開くことができません "},
    {kTextRecordLengthPositive, "Record Length must be greater than 0",
     "観測期間は 0 より大きくなければなりません"},
    {kTextThresholdNotNegative, "Threshold Level must be greater or equal to 0",
     "閾値は 0 以上でなければなりません"},
    {kTextAverageNumberPositive, "Avg. Annual No. of Exceedance must be greater than 0",
     "年平均超過回数は 0 より大きくなければなりません"},
    {kTextInterTimeNotNegative, "Inter Event Time must be greater or equal to 0",
     "イベント間隔時間は 0 以上でなければなりません"},
    {kTextInterLevelFraction, "Inter Event Level must be in interval (0,1)",
     "イベント間水位比は (0,1) の範囲でなければなりません"},
    {kTextThresholdBelowMaximum, "Threshold must be smaller than %.3f",
     "閾値は %.3f より小さくなければなりません"},
    {kTextInputFileMissing, "Input file not specified", "入力ファイルが指定されていません"},
    {kTextOutputFileMissing, "Output file not specified", "出力ファイルが指定されていません"},
    {kTextThresholdAtMostMinimum, "Threshold must be smaller or equal to %.3f",
     "閾値は %.3f 以下でなければなりません"},
    {kTextReturnPeriodTooSmall, "Evaluated return period %.3f must be greater than %.3f",
     "評価する再現期間 %.3f は %.3f より大きくなければなりません"},
    {kTextExponentialAndTruncatedGumbel, "Exponential\nTruncated Gumbel",
     "指数分布\n切断グンベル分布"},
    {kTextSaveBeforeGoingOn, "File was not saved recently. Do you want to save it ?",
     "ファイルが最近保存されていません。保存しますか？"},
    {kTextExtractionCompleted, "Extraction of extreme value series completed.",
     "極値系列の抽出が完了しました。"},
    {kTextExtractionNameMissing, "Can not execute extraction - filename is missing",
     "抽出を実行できません。ファイル名が指定されていません"},
    {kTextExtractionInputUnreadable, "Can not open input file for extraction",
     "抽出の入力ファイルを開くことができません"},
    {kTextExtractionOutputUnwritable, "Can not open output file for extraction",
     "抽出の出力ファイルを開くことができません"},
    {kTextMissingYearsTitle, "Missing Years", "欠測年"},
    {kTextMissingYearsLabel, "List of missing years", "欠測年の一覧"},
    {kTextDataFileError, "Error type %d detected in file %s line %d\n",
     "エラー（種類 %d）がファイル %s の %d 行で検出されました\n"},
    {kTextSaveChangesTo, "Save changes to %s?", "%s への変更を保存しますか？"},
    {kTextExtractionOverInput,
     "The extreme value series would replace its own input file; choose another output file",
     "極値系列の出力先が入力ファイルと同じです。別の出力ファイルを選んでください"},
    {kTextExtractionInputBad, "The input file cannot be read: %s",
     "入力ファイルを読み込めません: %s"},
    {kTextExtractionWriteFailed, "The extreme value series could not be written: %s",
     "極値系列を書き込めませんでした: %s"},
    {kTextInvalidYearStart, "The start date of the year is not a valid date",
     "年の開始日が正しい日付ではありません"},
    {kTextInvalidSeason, "The start or end date of the season is not a valid date",
     "季節の開始日または終了日が正しい日付ではありません"},
});

constexpr bool IsAscending() {
    for (std::size_t i = 1; i < kEntries.size(); ++i)
        if (kEntries[i - 1].id >= kEntries[i].id)
            return false;
    return true;
}
static_assert(IsAscending());

} // namespace

std::string_view Text(int id) {
    const auto* const entry = std::lower_bound(
        kEntries.begin(), kEntries.end(), id,
        [](const Entry& candidate, int wanted) { return candidate.id < wanted; });
    if (entry == kEntries.end() || entry->id != id)
        return {};
    return CurrentLanguage() == Language::Japanese ? entry->japanese : entry->english;
}

std::string_view TextLine(int id, int line) {
    std::string_view rest = Text(id);
    for (int i = 0; i < line; ++i) {
        const std::size_t end = rest.find('\n');
        if (end == std::string_view::npos)
            return {};
        rest.remove_prefix(end + 1);
    }
    return rest.substr(0, rest.find('\n'));
}

} // namespace ryn
