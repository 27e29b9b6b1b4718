#include "stats_samples.h"

#include "stats/distribution.h"
#include "stats/resampling_draws.h"
#include "unit/stats/named_combinations.h"

#include <initializer_list>
#include <stdexcept>

namespace ryn::stats::bench {

namespace {

// Every combination can be fitted to the first 50 and 500 values of this sequence.
constexpr std::uint64_t kSeed = 1928;

std::vector<NamedCombination> NamedAll(SeriesKind kind, std::initializer_list<const char*> names) {
    std::vector<NamedCombination> all;
    for (const char* const name : names) {
        all.push_back({name, testing::Named(name), kind});
    }
    return all;
}

// Shape and scale are near those of the fits to the real series.
Distribution Parent(SeriesKind kind, const SeriesFrame& frame) {
    if (kind == SeriesKind::AnnualMaximum) {
        return Gev::Make({3.87, 0.2, 0.05}).value();
    }
    return GeneralisedPareto::Make({frame.threshold, 7.5, -0.1}, LocationType::Fixed).value();
}

} // namespace

std::string KindName(SeriesKind kind) {
    return kind == SeriesKind::AnnualMaximum ? "AMS" : "PDS";
}

std::vector<NamedCombination> AnnualMaximumCombinations() {
    return NamedAll(SeriesKind::AnnualMaximum,
                    {"GEV/MOM",       "GEV/ML",  "GEV/LMOM",   "GUM/MOM",     "GUM/ML",
                     "GUM/LMOM",      "WEI/MOM", "WEI/LMOM",   "FRE/MOM",     "GP/MOM",
                     "GP/LMOM",       "P3/MOM",  "P3/LMOM",    "LP3/MOM/LOG", "LP3/MOM/REAL",
                     "LP3/LMOM",      "LN2/MOM", "LN3/MOM/BI", "LN3/MOM/BII", "LN3/MOM/LBQI",
                     "LN3/MOM/LBQII", "LN2/ML",  "LN3/ML",     "LN2/LMOM",    "SQE/ML"});
}

std::vector<NamedCombination> PartialDurationCombinations() {
    return NamedAll(SeriesKind::PartialDuration,
                    {"WEI2/MOM",  "WEI3/MOM",  "WEI2/ML",  "WEI2/LMOM", "WEI3/LMOM", "GP2/MOM",
                     "GP3/MOM",   "GP2/ML",    "GP2/LMOM", "GP3/LMOM",  "GAM/MOM",   "P3/MOM",
                     "GAM/ML",    "GAM/LMOM",  "P3/LMOM",  "EXP1/MOM",  "EXP2/MOM",  "EXP1/ML",
                     "EXP1/LMOM", "EXP2/LMOM", "TGUM/ML"});
}

std::vector<NamedCombination> AllCombinations() {
    std::vector<NamedCombination> all = AnnualMaximumCombinations();
    for (NamedCombination& named : PartialDurationCombinations()) {
        all.push_back(std::move(named));
    }
    return all;
}

Sample RealSample(SeriesKind kind, std::size_t count) {
    const std::string name = kind == SeriesKind::AnnualMaximum ? "portpirie" : "rain30";
    Sample sample{testing::ReferenceSeries(name), testing::FrameOf(name)};
    if (sample.values.size() < count) {
        throw std::runtime_error(name + " is shorter than " + std::to_string(count));
    }
    sample.values.resize(count);
    return sample;
}

Sample DrawnSample(SeriesKind kind, std::size_t count) {
    Sample sample{{}, testing::FrameOf(kind == SeriesKind::AnnualMaximum ? "portpirie" : "rain30")};
    const Distribution parent = Parent(kind, sample.frame);
    UniformDraws draws(kSeed);
    for (std::size_t i = 0; i < count; ++i) {
        sample.values.push_back(Quantile(parent, draws.Next()));
    }
    return sample;
}

} // namespace ryn::stats::bench
