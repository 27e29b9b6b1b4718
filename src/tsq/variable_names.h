#pragma once

#include <cstddef>
#include <set>
#include <string>
#include <string_view>
#include <unordered_map>

namespace ryn {

/// Names for the variables of one file. An item's name may be anything; a variable's is made of it
/// from letters, digits and underscores, as CF recommends, begins with a letter, and is given once.
class VariableNames {
  public:
    /// Keeps a name from being given.
    void Reserve(const std::string& name) { used.insert(name); }
    /// `number` stands in for a name of which nothing is left: "item_3".
    std::string For(std::string_view itemName, std::size_t number);

  private:
    std::set<std::string> used;
    std::unordered_map<std::string, std::size_t> lastNumber; // of items that make the same name
};

} // namespace ryn
