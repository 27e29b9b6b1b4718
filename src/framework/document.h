#pragma once

#include <functional>
#include <string>

#include "framework/object.h"
#include "ports/ports.h"

namespace ryn {

/// A document: a path name, a title, a modified flag, and the operations that the application
/// drives it by. Operations return non-zero on success.
class CDocument : public CObject {
  public:
    CDocument();

    const CRuntimeClass& GetRuntimeClass() const override;
    static CRuntimeClass& RuntimeClass();

    /// The ways to the outside; silent until they are given.
    const Ports& GetPorts() const { return *ports; }
    virtual void UsePorts(const Ports& outside) { ports = &outside; }

    /// Absolute; empty for a document that was never opened or saved.
    const std::string& GetPathName() const { return pathName; }
    /// The file's name without its directory; "Untitled" for a document without a path.
    const std::string& GetTitle() const { return title; }
    void SetTitle(std::string text) { title = std::move(text); }
    /// Takes the path as name and title; with addToRecentList 1 also enters it in the list of
    /// recent files.
    virtual void SetPathName(const std::string& path, int addToRecentList);

    bool IsModified() const { return modified; }
    virtual void SetModifiedFlag(int flag) { modified = flag != 0; }

    virtual int OnNewDocument();
    virtual int OnOpenDocument(const std::string& path) = 0;
    virtual int OnSaveDocument(const std::string& path) = 0;
    /// Asks whoever owns the document to close its frames and destroy it. The document is gone when
    /// this returns, if an owner was told to listen.
    virtual void OnCloseDocument();

    /// Set by the owner: called by OnCloseDocument.
    std::function<void(CDocument&)> closeRequested;

  private:
    const Ports* ports;
    std::string pathName;
    std::string title;
    bool modified = false;
};

/// The title of a document that was never saved or opened; compared literally.
inline constexpr const char* kUntitled = "Untitled";

} // namespace ryn
