#include "run/result_layout.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>

#include <fmt/printf.h>

namespace ryn {

namespace {

struct GoodnessStatistic {
    bool SGOFItem::*isWanted;
    double SGOFItem::*value;
    const char* name;
};

constexpr std::array kGoodness = std::to_array<GoodnessStatistic>({
    {&SGOFItem::ChiSquaredTest, &SGOFItem::ChiSquaredStatistic, "Chi-Squared Statistic"},
    {&SGOFItem::KolmogorovSmirnovTest, &SGOFItem::KolmogorovSmirnovStatistic,
     "Kolmogorov-Smirnov Statistic"},
    {&SGOFItem::SLSCTest, &SGOFItem::SLSCStatistic, "SLSC Statistic"},
    {&SGOFItem::PPCCTest, &SGOFItem::PPCCStatistic, "PPCC I Statistic"},
    {&SGOFItem::PPCC2Test, &SGOFItem::PPCC2Statistic, "PPCC II Statistic"},
    {&SGOFItem::LogLikelihood, &SGOFItem::LogLikelihoodStatistic, "Log-Likelihood Statistic"},
});

struct Parameter {
    bool SSampleStatItem::*exists;
    double SSampleStatItem::*value;
    std::string SSampleStatItem::*symbol;
};

constexpr std::array kParameters = std::to_array<Parameter>({
    {&SSampleStatItem::bParEst1, &SSampleStatItem::ParEst1, &SSampleStatItem::strParEst1},
    {&SSampleStatItem::bParEst2, &SSampleStatItem::ParEst2, &SSampleStatItem::strParEst2},
    {&SSampleStatItem::bParEst3, &SSampleStatItem::ParEst3, &SSampleStatItem::strParEst3},
});

/// Gathers the numbers of one point.
class PointRow {
  public:
    PointRow(const ResultLayout& layout, float missingValue) : missing(missingValue) {
        row.reserve(static_cast<std::size_t>(layout.Items()));
    }

    // A number beyond the range of floats would be stored as infinite, which no map can show.
    void Add(double value) {
        const bool fits =
            std::fabs(value) <= static_cast<double>(std::numeric_limits<float>::max());
        row.push_back(fits ? static_cast<float>(value) : missing);
    }
    void AddMissing() { row.push_back(missing); }
    void Add(const DoubleList& values) {
        for (const double value : values)
            Add(value);
    }
    std::vector<float> Take() { return std::move(row); }

  private:
    float missing;
    std::vector<float> row;
};

void AddStatistics(PointRow& row, const CSampleStatsSettings& page) {
    for (const double value : {page.Mean, std::sqrt(page.Variance), page.Skewness, page.Kurtosis,
                               page.L_2 / page.L_1, page.L_skewness, page.L_Kurtosis})
        row.Add(value);
}

void AddQuantiles(PointRow& row, const SEQItem& item, bool withUncertainty) {
    row.Add(item.TyearEvent);
    if (!withUncertainty)
        return;
    row.Add(item.AvgTyearEvent);
    row.Add(item.StdTyearEvent);
}

int StatisticsOf(const SGOFItem& item) {
    return static_cast<int>(
        std::count_if(kGoodness.begin(), kGoodness.end(),
                      [&item](const GoodnessStatistic& each) { return item.*each.isWanted; }));
}

/// Names the items of one list after another.
class ItemNames {
  public:
    ItemNames(CGlobalKvf& root, const COutputSettings& model)
        : results(model),
          periods(root.Analysis().EvaluatedReturnPeriods) {
        for (const auto& combination : root.Distributions().Combinations)
            labels.push_back(combination->ItemName + " - ");
    }

    std::vector<ResultItem> All(bool withUncertainty) {
        for (const char* name : {"Mean", "Standard deviation"})
            items.push_back({name, true});
        for (const char* name : {"Skewness", "Kurtosis", "L-Cv", "L-Skewness", "L-Kurtosis"})
            items.push_back({name, false});
        AddParameters();
        AddGoodness();
        AddQuantiles(withUncertainty);
        return std::move(items);
    }

  private:
    void AddParameters() {
        const std::vector<SSampleStatItem>& list = results.SampleStats.Items();
        for (std::size_t c = 0; c < list.size(); ++c)
            for (const Parameter& parameter : kParameters)
                items.push_back({labels[c] + list[c].*parameter.symbol, false});
    }
    void AddGoodness() {
        const std::vector<SGOFItem>& list = results.GoodnessOfFit.Items();
        for (std::size_t c = 0; c < list.size(); ++c)
            for (const GoodnessStatistic& each : kGoodness)
                if (list[c].*each.isWanted)
                    items.push_back({labels[c] + each.name, false});
    }
    void AddQuantiles(bool withUncertainty) {
        for (const std::string& label : labels) {
            AddForEachPeriod(label + "Estimated quantile");
            if (!withUncertainty)
                continue;
            AddForEachPeriod(label + "Average quantile");
            AddForEachPeriod(label + "Standard deviation");
        }
    }
    void AddForEachPeriod(const std::string& name) {
        for (const double period : periods)
            items.push_back({name + fmt::sprintf(" %.2f years", period), true});
    }

    const COutputSettings& results;
    const std::vector<double>& periods;
    std::vector<std::string> labels;
    std::vector<ResultItem> items;
};

} // namespace

ResultLayout ResultLayout::Of(CGlobalKvf& root) {
    const CAnalysisKvf& analysis = root.Analysis();
    ResultLayout layout;
    layout.combinations = static_cast<int>(root.Distributions().Combinations.size());
    for (const bool isWanted :
         {analysis.ChiSquaredTest, analysis.KolmogorovSmirnovTest, analysis.SLSCTest,
          analysis.PPCCTest, analysis.PPCCTest2, analysis.LogLikelihood})
        layout.statistics += isWanted ? 1 : 0;
    layout.returnPeriods = static_cast<int>(analysis.EvaluatedReturnPeriods.size());
    layout.withUncertainty = root.GridInput().UncertaintyCal;
    return layout;
}

std::vector<float> PointResults(const COutputSettings& results, const ResultLayout& layout,
                                float missing) {
    PointRow row(layout, missing);
    AddStatistics(row, results.SampleStats);
    for (const SSampleStatItem& item : results.SampleStats.Items())
        for (const Parameter& parameter : kParameters)
            if (item.*parameter.exists)
                row.Add(item.*parameter.value);
            else
                row.AddMissing();
    for (const SGOFItem& item : results.GoodnessOfFit.Items())
        for (const GoodnessStatistic& each : kGoodness)
            if (item.*each.isWanted)
                row.Add(item.*each.value);
    for (const SEQItem& item : results.Quantiles.Items())
        AddQuantiles(row, item, layout.withUncertainty);
    return row.Take();
}

bool HasLayout(const COutputSettings& results, const ResultLayout& layout) {
    const auto combinations = static_cast<std::size_t>(layout.combinations);
    const auto periods = static_cast<std::size_t>(layout.returnPeriods);
    const auto& goodness = results.GoodnessOfFit.Items();
    const auto& quantiles = results.Quantiles.Items();
    const auto hasPeriods = [&](const SEQItem& item) {
        return item.TyearEvent.size() == periods &&
               (!layout.withUncertainty ||
                (item.AvgTyearEvent.size() == periods && item.StdTyearEvent.size() == periods));
    };
    return results.HasOutput() && results.SampleStats.Items().size() == combinations &&
           goodness.size() == combinations && quantiles.size() == combinations &&
           std::all_of(
               goodness.begin(), goodness.end(),
               [&](const SGOFItem& item) { return StatisticsOf(item) == layout.statistics; }) &&
           std::all_of(quantiles.begin(), quantiles.end(), hasPeriods);
}

std::vector<ResultItem> ResultItems(CGlobalKvf& root, const COutputSettings& results,
                                    const ResultLayout& layout) {
    return ItemNames(root, results).All(layout.withUncertainty);
}

} // namespace ryn
