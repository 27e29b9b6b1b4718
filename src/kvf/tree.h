#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <memory>
#include <set>
#include <string>
#include <string_view>
#include <unordered_map>
#include <variant>
#include <vector>

#include "kvf/kvf.h"

/// The nodes behind the handles of kvf.h. A tree owns its nodes in deques, which never move them,
/// and refers to names and texts by pointer, so that a file of 10^6 keywords stays within some
/// ten times its own size.
namespace ryn {

/// What the text format allows; docs/formats/kvf.md.
constexpr std::size_t kKvfMaxDepth = 200;
constexpr std::size_t kKvfMaxFileSize = std::size_t{256} << 20; // 256 MiB

struct KvfText {
    const std::string* text;
};
struct KvfFileName {
    const std::string* text;
};

/// A value; the alternatives stand in the order of KvfType.
struct KvfParam {
    std::variant<int, float, double, bool, KvfText, KvfFileName> value;
};

enum class KvfNodeKind : std::uint8_t { Section, Keyword };

/// What sections and keywords share. Two nodes of one tree have the same name exactly when their
/// name pointers are equal.
struct KvfNode {
    KvfNode(KvfTree* owner, const std::string* label, KvfNodeKind type)
        : tree(owner),
          name(label),
          kind(type) {}

    KvfTree* tree;
    const std::string* name;
    KvfNodeKind kind;
};

/// The parameters are a run in the tree's store of parameters.
struct KvfKeyword : KvfNode {
    KvfKeyword(KvfTree* owner, const std::string* label)
        : KvfNode(owner, label, KvfNodeKind::Keyword) {}

    std::uint32_t count = 0;
    std::size_t first = 0;
};

/// The occurrences of each name among a section's children.
class KvfNameIndex {
  public:
    /// The node, or null. `children` may have grown since the last call.
    KvfNode* Find(const std::vector<KvfNode*>& children, KvfNodeKind kind, const std::string* name,
                  std::size_t occurrence);

  private:
    using Occurrences = std::unordered_map<const std::string*, std::vector<KvfNode*>>;

    std::array<Occurrences, 2> byKind;
    std::size_t indexed = 0; // this many children are in
};

/// A target or section, or the level above the targets.
struct KvfSection : KvfNode {
    KvfSection(KvfTree* owner, const std::string* label)
        : KvfNode(owner, label, KvfNodeKind::Section) {}

    std::vector<KvfNode*> children; // in file order
    /// Made by the first lookup among more than a few children.
    mutable std::unique_ptr<KvfNameIndex> index;
};

class KvfTree {
  public:
    KvfTree();
    KvfTree(const KvfTree&) = delete;
    KvfTree& operator=(const KvfTree&) = delete;

    KvfSection* Root() { return &root; }
    const KvfSection* Root() const { return &root; }

    KvfSection* AppendSection(KvfSection* parent, std::string_view name);
    KvfKeyword* AppendKeyword(KvfSection* parent, std::string_view name);
    void AppendParam(KvfKeyword* keyword, KvfParam param);
    /// A text kept by the tree, for a KvfText or KvfFileName.
    const std::string* StoreText(std::string text);

    const KvfParam& Param(std::size_t position) const { return params[position]; }
    /// The tree's name of this spelling; null when no node has it.
    const std::string* FindName(std::string_view name) const;

    std::vector<KvfSection*> open; // the cursor: target and sections, innermost last
    KvfKeyword* openKeyword = nullptr;

  private:
    const std::string* Intern(std::string_view name);

    // Ordered and not hashed: a hostile file could choose names of one hash.
    std::set<std::string, std::less<>> names;
    std::deque<KvfSection> sections;
    std::deque<KvfKeyword> keywords;
    std::deque<KvfParam> params;
    std::deque<std::string> texts;
    KvfSection root;
};

/// The child of this kind, name and occurrence; null when there is none or `parent` is null.
KvfNode* KvfFindChild(const KvfSection* parent, KvfNodeKind kind, std::string_view name,
                      int occurrence);

/// Calls the visitor for everything inside a section. Without recursion: a tree built by calls can
/// be of any depth.
void KvfVisitChildren(const KvfSection& section, KvfVisitor& visitor);

} // namespace ryn
