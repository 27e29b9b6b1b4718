#pragma once

#include <string>

#include "framework/message.h"
#include "kvf/kvf.h"

namespace ryn {

/// Base of every parameter section. A section knows its parent; the root has none.
class CKvfBase {
  public:
    explicit CKvfBase(CKvfBase* parentSection = nullptr) : parent(parentSection) {}
    virtual ~CKvfBase() = default;
    CKvfBase(const CKvfBase&) = delete;
    CKvfBase& operator=(const CKvfBase&) = delete;

    /// Appends one message for each fault of the section's values; returns how many.
    virtual int Check(CMessageList& messages, int flag);
    /// Adds the section, its keywords and sub-sections to the tree being built. File names are
    /// written relative to `baseDirectory` where the section says so.
    virtual void Write(KvfTree* file, const std::string& baseDirectory) = 0;
    /// Finds the section in the enclosing target or section and fills the members; a keyword that
    /// is missing leaves its member as it was. A null handle finds nothing.
    virtual void Read(const KvfSection* enclosing, const std::string& baseDirectory) = 0;
    /// Does nothing in every section of this system.
    virtual void Reset(int argument);
    virtual CKvfBase* GetRoot();
    const CKvfBase* GetRoot() const;
    virtual CKvfBase* GetParent();
    /// A child section by id; null, since the sections here have no ids.
    virtual CKvfBase* FindChildKvf(unsigned long id);

    void SetParent(CKvfBase* section) { parent = section; }

  private:
    CKvfBase* parent;
};

} // namespace ryn
