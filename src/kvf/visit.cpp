#include "kvf/kvf.h"
#include "kvf/tree.h"

namespace ryn {

namespace {

void VisitKeyword(const KvfKeyword& keyword, KvfVisitor& visitor) {
    visitor.BeginKeyword(*keyword.name, kvfGetNoParams(&keyword));
    for (std::size_t i = 0; i < keyword.count; ++i)
        visitor.Parameter(keyword.tree->Param(keyword.first + i));
    visitor.EndKeyword();
}

/// Appends what it is told to a section of another tree.
class Copier : public KvfVisitor {
  public:
    explicit Copier(KvfSection* destination)
        : tree(*destination->tree),
          openSections{destination} {}

    void BeginSection(std::string_view name) override {
        openSections.push_back(tree.AppendSection(openSections.back(), name));
    }
    void EndSection() override { openSections.pop_back(); }
    void BeginKeyword(std::string_view name, int) override {
        keyword = tree.AppendKeyword(openSections.back(), name);
    }
    void Parameter(const KvfParam& parameter) override {
        tree.AppendParam(keyword, WithOwnText(parameter));
    }
    void EndKeyword() override {}

  private:
    KvfParam WithOwnText(const KvfParam& parameter) {
        if (const auto* text = std::get_if<KvfText>(&parameter.value))
            return {KvfText{tree.StoreText(*text->text)}};
        if (const auto* name = std::get_if<KvfFileName>(&parameter.value))
            return {KvfFileName{tree.StoreText(*name->text)}};
        return parameter;
    }

    KvfTree& tree;
    std::vector<KvfSection*> openSections;
    KvfKeyword* keyword = nullptr;
};

} // namespace

void KvfVisitChildren(const KvfSection& section, KvfVisitor& visitor) {
    struct Place {
        const KvfSection* section;
        std::size_t next;
    };
    std::vector<Place> path{{&section, 0}};
    while (!path.empty()) {
        Place& place = path.back();
        if (place.next == place.section->children.size()) {
            path.pop_back();
            if (!path.empty())
                visitor.EndSection();
            continue;
        }
        const KvfNode* const child = place.section->children[place.next++];
        if (child->kind == KvfNodeKind::Keyword) {
            VisitKeyword(static_cast<const KvfKeyword&>(*child), visitor);
        } else {
            visitor.BeginSection(*child->name);
            path.push_back({static_cast<const KvfSection*>(child), 0});
        }
    }
}

void kvfVisit(const KvfTree* tree, KvfVisitor& visitor) {
    if (tree != nullptr)
        KvfVisitChildren(*tree->Root(), visitor);
}

void kvfCopy(const KvfSection* source, KvfSection* destination) {
    if (source == nullptr || destination == nullptr)
        return;
    if (source->tree == destination->tree) {
        // By way of another tree: a section copied into itself or its own part would never end.
        KvfTree aside;
        kvfCopy(source, aside.Root());
        kvfCopy(aside.Root(), destination);
        return;
    }
    Copier copier(destination);
    KvfVisitChildren(*source, copier);
}

} // namespace ryn
