#include "results/result_file.h"

#include <functional>

namespace ryn {

namespace {

constexpr const char* kOutput = "RYNoutput";
constexpr const char* kSettings = "OutputSettings";
constexpr const char* kGraphs = "Graphs";
constexpr const char* kHistogram = "Histogram";

void AddTarget(KvfTree* tree, const char* name, const std::function<void(KvfTree*)>& fill) {
    kvfAddTarget(tree, name);
    fill(tree);
    kvfEndSection(tree);
}

void AddOutput(KvfTree* tree, const COutputSettings& results) {
    AddTarget(tree, kOutput, [&](KvfTree* open) { results.SaveOutput(open); });
}

void AddSettings(KvfTree* tree, COutputSettings& results, const std::string& baseDirectory) {
    AddTarget(tree, kSettings, [&](KvfTree* open) { results.SaveSettings(open, baseDirectory); });
}

/// Adds a kept plot's target behind what the tree holds.
void AddKept(KvfTree* tree, const KvfHandle& kept, const char* name) {
    if (kept == nullptr)
        return;
    KvfSection* const copy = kvfAddTarget(tree, name);
    kvfEndSection(tree);
    kvfCopy(kvfTargetByNameNum(kept.get(), name, 1), copy);
}

/// Keeps a copy of a plot's target, which is opaque here.
void KeepTarget(const KvfTree* file, const char* name, KvfHandle* kept) {
    const KvfSection* const stored = kvfTargetByNameNum(file, name, 1);
    if (stored == nullptr)
        return;
    kvfClose(kept);
    *kept = kvfCreate();
    KvfSection* const copy = kvfAddTarget(kept->get(), name);
    kvfEndSection(kept->get());
    kvfCopy(stored, copy);
}

} // namespace

void TakeEngineOutput(KvfHandle* tree, COutputSettings& results) {
    results.LoadOutput(kvfTargetByNameNum(tree->get(), kOutput, 1), "");
    kvfClose(tree);
}

Status WriteResultsOfRun(COutputSettings& results, const std::string& path, Durability durability) {
    KvfHandle output = kvfCreate();
    AddOutput(output.get(), results);
    Status written = kvfWrite(output.get(), path, durability);
    kvfClose(&output);
    if (!written)
        return written;
    const KvfHandle settings = kvfCreate();
    AddSettings(settings.get(), results, "");
    return kvfAppend(settings.get(), path, durability);
}

Status WriteResultsOfDocument(COutputSettings& results, const std::string& path,
                              const std::string& baseDirectory, Durability durability) {
    KvfHandle tree = kvfCreate();
    AddOutput(tree.get(), results);
    AddSettings(tree.get(), results, baseDirectory);
    // In one write: appended one by one, a kill or a full disk in between would lose a plot's look.
    AddKept(tree.get(), results.GraphsKvf, kGraphs);
    AddKept(tree.get(), results.HistogramKvf, kHistogram);
    Status written = kvfWrite(tree.get(), path, durability);
    kvfClose(&tree);
    return written;
}

Status ReadResultFile(COutputSettings& results, const std::string& path,
                      const std::string& baseDirectory) {
    KvfHandle tree = kvfLoadFile(path, 0);
    if (kvfPeekErrorGlb() != 0) {
        kvfGetErrorGlb();
        std::string reason;
        kvfGetSyntaxErr(tree.get(), nullptr, nullptr, &reason);
        return Status::InputFault(std::move(reason));
    }
    // The settings first: they empty the model and leave the flags that the results then extend.
    if (const KvfSection* const target = kvfTargetByNameNum(tree.get(), kSettings, 1)) {
        results.LoadSettings(target, baseDirectory);
        results.SetValid(true);
    }
    if (const KvfSection* const target = kvfTargetByNameNum(tree.get(), kOutput, 1))
        results.LoadOutput(target, baseDirectory);
    KeepTarget(tree.get(), kHistogram, &results.HistogramKvf);
    KeepTarget(tree.get(), kGraphs, &results.GraphsKvf);
    kvfClose(&tree);
    return Status::Ok();
}

} // namespace ryn
