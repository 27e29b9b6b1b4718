#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include "framework/dlg_enumerator.h"
#include "framework/kvf_base.h"
#include "framework/qx_doc.h"

namespace ryn {

/// A document of parameter sections and pages: holds the root section, the page enumerator and the
/// file extension. The derived class makes them.
class CK44SetupDoc : public CQxDoc {
  public:
    const CRuntimeClass& GetRuntimeClass() const override;
    static CRuntimeClass& RuntimeClass();

    CKvfBase* GetKvf() const { return rootSection.get(); }
    const CK44SetupDlgEnumerator* GetEnumerator() const { return enumerator.get(); }

    /// Whether a computation of the document is under way; false: commands block.
    virtual bool IsExecuting() const { return false; }
    /// Whether a page cannot be selected; false for every page.
    virtual bool Disabled(std::uint32_t page) const;
    /// For a framework that serves several engines; this system has one, and does nothing.
    virtual void SetEngine(const std::string& name);

  protected:
    FileChoicePort::SaveRequest MakeSaveRequest() const override;

    // In this order: the root goes before the enumerator when the document is destroyed.
    std::unique_ptr<CK44SetupDlgEnumerator> enumerator;
    std::string fileExtension; ///< without the point
    std::unique_ptr<CKvfBase> rootSection;
};

} // namespace ryn
