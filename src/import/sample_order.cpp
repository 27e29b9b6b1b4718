#include "import/sample_order.h"

#include <algorithm>
#include <numeric>

namespace ryn {

namespace {

void SortByTime(TableSamples* samples) {
    // Most tables are sorted, and need no copy.
    if (std::is_sorted(samples->times.begin(), samples->times.end()))
        return;
    std::vector<std::size_t> order(samples->Count());
    std::iota(order.begin(), order.end(), std::size_t{0});
    // Stable, so that "first" and "last" of equal times mean the order in the table.
    std::stable_sort(order.begin(), order.end(), [samples](std::size_t a, std::size_t b) {
        return samples->times[a] < samples->times[b];
    });
    const TableSamples unsorted = *samples;
    for (std::size_t i = 0; i < order.size(); ++i) {
        samples->times[i] = unsorted.times[order[i]];
        samples->lines[i] = unsorted.lines[order[i]];
        for (std::size_t item = 0; item < samples->values.size(); ++item)
            samples->values[item][i] = unsorted.values[item][order[i]];
    }
}

/// Into the sample kept. The first one's values are there already.
void Merge(std::size_t from, std::size_t to, DuplicateRule rule, TableSamples* samples) {
    for (std::vector<float>& item : samples->values) {
        if (rule == DuplicateRule::Last)
            item[to] = item[from];
        else if (rule == DuplicateRule::Maximum)
            item[to] = std::max(item[to], item[from]);
    }
}

/// Merges neighbours of the same time.
void MergeDuplicates(DuplicateRule rule, TableSamples* samples, ImportReport* report) {
    std::size_t kept = 0;
    for (std::size_t i = 1; i < samples->Count(); ++i) {
        // Neighbours only: without --sort equal times further apart are backward steps, and stay a
        // fault.
        if (samples->times[i] == samples->times[kept]) {
            report->Dropped(DropReason::Duplicate).Add(samples->lines[i]);
            Merge(i, kept, rule, samples);
        } else {
            samples->Move(i, ++kept);
        }
    }
    if (samples->Count() > 0)
        samples->Resize(kept + 1);
}

std::string TimeText(const TableSamples& samples, std::size_t i) {
    return samples.isRelative ? std::to_string(samples.times[i] / kMillisPerSecond) + " s"
                              : MomentText(samples.times[i]);
}

} // namespace

Status OrderSamples(const std::string& source, RowOrder order, DuplicateRule rule,
                    TableSamples* samples, ImportReport* report) {
    if (order == RowOrder::Any)
        SortByTime(samples);
    if (rule != DuplicateRule::Refuse)
        MergeDuplicates(rule, samples, report);
    DroppedRows backward;
    DroppedRows repeated;
    std::string first;
    for (std::size_t i = 1; i < samples->Count(); ++i) {
        if (samples->times[i] > samples->times[i - 1])
            continue;
        const bool isEqual = samples->times[i] == samples->times[i - 1];
        if (first.empty())
            first = TimeText(*samples, i) + " after " + TimeText(*samples, i - 1);
        (isEqual ? repeated : backward).Add(samples->lines[i]);
    }
    if (first.empty())
        return Status::Ok();
    // Lines and remedy in one message: the user decides with the table at hand.
    std::string text = source + ":";
    if (backward.count > 0)
        text += " time runs backwards in line " + LineList(backward.firstLines, backward.count) +
                " (allow it with --sort)";
    if (repeated.count > 0)
        text += std::string(backward.count > 0 ? ";" : "") + " a time is repeated in line " +
                LineList(repeated.firstLines, repeated.count) +
                " (choose with --duplicates first, last or max)";
    return Status::InputFault(text + "; first: " + first);
}

} // namespace ryn
