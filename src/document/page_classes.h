#pragma once

#include <string_view>

#include "framework/object.h"

namespace ryn {

/// The run-time class of a page by its name ("CBasicForm", "CTableView", ...), or null. The desktop
/// side fills in how an object is made.
CRuntimeClass* FindPageClass(std::string_view className);

} // namespace ryn
