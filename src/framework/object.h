#pragma once

#include <functional>
#include <memory>
#include <string_view>

namespace ryn {

class CObject;

/// What is known of a class at run time: its name, its base, and how to make an object of it. The
/// headless half of the program knows pages by name alone; the desktop half fills in `create`.
struct CRuntimeClass {
    std::string_view className;
    const CRuntimeClass* base = nullptr;
    std::function<std::unique_ptr<CObject>()> create = {};

    /// True for the class itself and for every class on the way to the root.
    bool IsDerivedFrom(const CRuntimeClass& other) const;
};

/// Base of all classes that are known at run time.
class CObject {
  public:
    virtual ~CObject() = default;
    virtual const CRuntimeClass& GetRuntimeClass() const;

    static CRuntimeClass& RuntimeClass();
};

} // namespace ryn
