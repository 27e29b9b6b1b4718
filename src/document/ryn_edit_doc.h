#pragma once

#include <string>

#include "base/atomic_file.h"
#include "framework/setup_doc.h"
#include "params/global_kvf.h"

namespace ryn {

/// One analysis: the parameter tree of one .ryn file.
class CRynEditDoc : public CK44SetupDoc {
  public:
    CRynEditDoc();

    const CRuntimeClass& GetRuntimeClass() const override;
    static CRuntimeClass& RuntimeClass();

    void UsePorts(const Ports& outside) override;

    /// The root section.
    CGlobalKvf& GetGlobalKvf() { return *globalKvf; }

    int OnNewDocument() override;
    /// Opens a ".RYN" or ".ryn" file; another name shows message 3981 and gives 0. A file that
    /// cannot be read, or has a syntax error, shows the reason, leaves the default sections and
    /// gives 1. Sets the process's current directory to the file's.
    int OnOpenDocument(const std::string& path) override;
    /// Saves under the path's name with the document's extension; always gives 1. Whether the file
    /// could be written is TakeSaveError's to tell.
    int OnSaveDocument(const std::string& path) override;
    Status TakeSaveError() override;

    /// Whether the last open read a whole parameter file. After one that did not, the first save
    /// keeps the old file as NAME.broken.
    bool WasReadWhole() const { return readWhole; }

    /// How saves are written; flushed unless told otherwise.
    void SetDurability(Durability wanted) { durability = wanted; }

  private:
    void LoadParameters(const std::string& path, const std::string& baseDirectory);
    void WriteFiles(const std::string& path);
    void NoteSaveError(Status status);

    CGlobalKvf* globalKvf; // the root section, by its own type
    Durability durability = Durability::Flushed;
    bool readWhole = true;
    std::string brokenFile; // the file that the last open could not read whole
    Status saveError;
};

} // namespace ryn
