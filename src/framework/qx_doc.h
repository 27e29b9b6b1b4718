#pragma once

#include <string>

#include "base/status.h"
#include "framework/document.h"

namespace ryn {

/// A document that is saved to a file which the user chooses.
class CQxDoc : public CDocument {
  public:
    const CRuntimeClass& GetRuntimeClass() const override;
    static CRuntimeClass& RuntimeClass();

    /// Asks whether to save a modified document. Non-zero when the caller may go on: nothing to
    /// save, saved, or not wanted.
    virtual int SaveModified();
    /// Saves under `path`, or under a name that the user chooses when it is empty. Shows the reason
    /// when the save failed and leaves the document modified. Non-zero when it was saved. With
    /// `replace` zero the document keeps its own name: a copy is saved.
    virtual int DoSave(const std::string& path, int replace = 1);

    /// Why the last save failed; Ok when it did not. Clears it.
    virtual Status TakeSaveError();

  protected:
    /// What the choice of a file to save offers.
    virtual FileChoicePort::SaveRequest MakeSaveRequest() const;
};

} // namespace ryn
