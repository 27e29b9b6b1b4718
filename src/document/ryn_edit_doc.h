#pragma once

#include <string>

#include "base/atomic_file.h"
#include "framework/setup_doc.h"
#include "params/global_kvf.h"
#include "results/output_settings.h"

namespace ryn {

/// One analysis: the parameter tree of one .ryn file, and the results in the file that the tree
/// names, where there are any.
class CRynEditDoc : public CK44SetupDoc {
  public:
    CRynEditDoc();
    ~CRynEditDoc() override;

    const CRuntimeClass& GetRuntimeClass() const override;
    static CRuntimeClass& RuntimeClass();

    void UsePorts(const Ports& outside) override;

    /// The root section.
    CGlobalKvf& GetGlobalKvf() { return *globalKvf; }
    COutputSettings& Results() { return results; }

    int OnNewDocument() override;
    /// Opens a ".RYN" or ".ryn" file; another name shows message 3981 and gives 0. A file that
    /// cannot be read, or has a syntax error, shows the reason, leaves the default sections and
    /// gives 1. Sets the process's current directory to the file's. A result file that is missing
    /// or broken is passed over in silence: the document has no results then.
    int OnOpenDocument(const std::string& path) override;
    /// Saves under the path's name with the document's extension, and the result file when there
    /// are results; always gives 1. Whether the files could be written is TakeSaveError's to tell.
    int OnSaveDocument(const std::string& path) override;
    Status TakeSaveError() override;

    /// Whether the last open read a whole parameter file. After one that did not, the first save
    /// keeps the old file as NAME.broken.
    bool WasReadWhole() const { return readWhole; }

    /// Why the last open found no results in the result file that the parameters name; Ok when it
    /// did, and when they name none.
    const Status& ResultError() const { return resultError; }

    /// A fault when the result file that the parameters name is another file of the analysis (the
    /// parameter file, a data, series or grid file, one that the engine writes), which writing the
    /// results would destroy.
    Status TestResultFileName() const;

    /// How saves are written; flushed unless told otherwise.
    void SetDurability(Durability wanted) { durability = wanted; }

  private:
    void LoadParameters(const std::string& path, const std::string& baseDirectory);
    void LoadResults(const std::string& baseDirectory);
    Status WriteParameters(const std::string& path, const std::string& baseDirectory);
    Status WriteResults(const std::string& baseDirectory);
    void NoteSaveError(Status status);

    COutputSettings results;
    CGlobalKvf* globalKvf; // the root section, by its own type
    Durability durability = Durability::Flushed;
    bool readWhole = true;
    std::string brokenFile; // the file that the last open could not read whole
    Status saveError;
    Status resultError;
};

} // namespace ryn
