#include "kvf/tree.h"

#include <utility>

namespace ryn {

namespace {

// Up to here comparing pointers is as fast as an index, and most sections need none.
constexpr std::size_t kFewChildren = 8;

KvfNode* Scan(const std::vector<KvfNode*>& children, KvfNodeKind kind, const std::string* name,
              std::size_t occurrence) {
    for (KvfNode* const child : children)
        if (child->kind == kind && child->name == name && --occurrence == 0)
            return child;
    return nullptr;
}

} // namespace

KvfNode* KvfNameIndex::Find(const std::vector<KvfNode*>& children, KvfNodeKind kind,
                            const std::string* name, std::size_t occurrence) {
    for (; indexed < children.size(); ++indexed) {
        KvfNode* const child = children[indexed];
        byKind[static_cast<std::size_t>(child->kind)][child->name].push_back(child);
    }
    const Occurrences& occurrences = byKind[static_cast<std::size_t>(kind)];
    const auto found = occurrences.find(name);
    if (found == occurrences.end() || occurrence > found->second.size())
        return nullptr;
    return found->second[occurrence - 1];
}

KvfTree::KvfTree() : root(this, Intern("")) {}

KvfSection* KvfTree::AppendSection(KvfSection* parent, std::string_view name) {
    KvfSection& section = sections.emplace_back(this, Intern(name));
    parent->children.push_back(&section);
    return &section;
}

KvfKeyword* KvfTree::AppendKeyword(KvfSection* parent, std::string_view name) {
    KvfKeyword& keyword = keywords.emplace_back(this, Intern(name));
    keyword.first = params.size();
    parent->children.push_back(&keyword);
    return &keyword;
}

void KvfTree::AppendParam(KvfKeyword* keyword, KvfParam param) {
    if (keyword->first + keyword->count != params.size()) {
        // A copy into this tree came between. The run goes on at the end; handles to the old
        // parameters stay good, since those stay where they are.
        const std::size_t old = std::exchange(keyword->first, params.size());
        for (std::size_t i = 0; i < keyword->count; ++i)
            params.push_back(params[old + i]);
    }
    params.push_back(param);
    ++keyword->count;
}

const std::string* KvfTree::StoreText(std::string text) {
    return &texts.emplace_back(std::move(text));
}

const std::string* KvfTree::FindName(std::string_view name) const {
    const auto found = names.find(name);
    return found == names.end() ? nullptr : &*found;
}

const std::string* KvfTree::Intern(std::string_view name) {
    if (const std::string* known = FindName(name))
        return known;
    return &*names.emplace(name).first;
}

KvfNode* KvfFindChild(const KvfSection* parent, KvfNodeKind kind, std::string_view name,
                      int occurrence) {
    if (parent == nullptr || occurrence < 1)
        return nullptr;
    const std::string* const known = parent->tree->FindName(name);
    if (known == nullptr)
        return nullptr;
    const auto number = static_cast<std::size_t>(occurrence);
    if (parent->children.size() <= kFewChildren)
        return Scan(parent->children, kind, known, number);
    if (!parent->index)
        parent->index = std::make_unique<KvfNameIndex>();
    return parent->index->Find(parent->children, kind, known, number);
}

} // namespace ryn
