#pragma once

#include <string>

#include "framework/object.h"
#include "kvf/kvf.h"

namespace ryn {

class COutputSettings;

/// Base of the result model and of its eight pages. A page's object is two things at once: the
/// page's share of the results, and the user's choices of what it shows.
///
/// The base directory that the operations take is the one that the parameter sections are given;
/// results hold no file names, so nothing here uses it.
class CSettingsTemplate : public CObject {
  public:
    /// Adds this object's section to the section OutputSettings, in which `file` stands.
    virtual void SaveSettings(KvfTree* file, const std::string& baseDirectory) = 0;
    /// Clears, then reads this object's section of `settings`, the section OutputSettings. A choice
    /// that is not there stays as it is.
    virtual void LoadSettings(const KvfSection* settings, const std::string& baseDirectory) = 0;
    /// Appends this object's share of the results in target RYNoutput.
    virtual void LoadOutput(const KvfSection* target, const std::string& baseDirectory) = 0;

    void SetParent(COutputSettings* owner) { parent = owner; }
    /// The result model; null in the result model itself.
    COutputSettings* GetParent() const { return parent; }

  private:
    COutputSettings* parent = nullptr;
};

} // namespace ryn
