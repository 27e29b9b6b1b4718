#pragma once

#include <cstdint>
#include <string>

#include "framework/object.h"

namespace ryn {

/// Answers for each page number of a document; the application derives its table of pages from it.
class CK44SetupDlgEnumerator {
  public:
    virtual ~CK44SetupDlgEnumerator() = default;
    /// The page's text in the tree, in the current language; empty for a number without one.
    virtual std::string GetPageTitle(std::uint32_t page) const = 0;
    /// The page's class, or null. Both strings are set empty first; a page without a class that
    /// shows a built-in HTML page fills them with its help topic and its address.
    virtual const CRuntimeClass* GetPageClass(std::uint32_t page, std::string& helpTopic,
                                              std::string& pageAddress) const = 0;
};

} // namespace ryn
