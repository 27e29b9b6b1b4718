#include <utility>

#include "kvf/kvf.h"
#include "kvf/tree.h"

namespace ryn {

namespace {

void Append(KvfTree* tree, KvfParam param) {
    if (tree != nullptr && tree->openKeyword != nullptr)
        tree->AppendParam(tree->openKeyword, param);
}

void Put(KvfTree* tree, std::string_view keyword, KvfParam param) {
    kvfAddKeyword(tree, keyword);
    Append(tree, param);
    if (tree != nullptr)
        tree->openKeyword = nullptr; // it has this one parameter
}

} // namespace

void KvfTreeDelete::operator()(KvfTree* tree) const {
    delete tree;
}

KvfHandle kvfCreate() {
    return KvfHandle(new KvfTree);
}

KvfSection* kvfAddTarget(KvfTree* tree, std::string_view name) {
    if (tree == nullptr)
        return nullptr;
    tree->open.clear();
    tree->openKeyword = nullptr;
    tree->open.push_back(tree->AppendSection(tree->Root(), name));
    return tree->open.back();
}

KvfSection* kvfAddSection(KvfTree* tree, std::string_view name) {
    if (tree == nullptr || tree->open.empty())
        return nullptr;
    tree->openKeyword = nullptr;
    tree->open.push_back(tree->AppendSection(tree->open.back(), name));
    return tree->open.back();
}

void kvfEndSection(KvfTree* tree) {
    if (tree == nullptr || tree->open.empty())
        return;
    tree->openKeyword = nullptr;
    tree->open.pop_back();
}

void kvfAddKeyword(KvfTree* tree, std::string_view name) {
    if (tree != nullptr && !tree->open.empty())
        tree->openKeyword = tree->AppendKeyword(tree->open.back(), name);
}

void kvfAddInt(KvfTree* tree, int value) {
    Append(tree, {value});
}

void kvfAddFloat(KvfTree* tree, float value) {
    Append(tree, {value});
}

void kvfAddDouble(KvfTree* tree, double value) {
    Append(tree, {value});
}

void kvfAddBool(KvfTree* tree, bool value) {
    Append(tree, {value});
}

void kvfPutParam(KvfTree* tree, std::string_view keyword, int value) {
    Put(tree, keyword, {value});
}

void kvfPutParam(KvfTree* tree, std::string_view keyword, bool value) {
    Put(tree, keyword, {value});
}

void kvfPutParam(KvfTree* tree, std::string_view keyword, float value) {
    Put(tree, keyword, {value});
}

void kvfPutParam(KvfTree* tree, std::string_view keyword, double value) {
    Put(tree, keyword, {value});
}

void kvfPutParam(KvfTree* tree, std::string_view keyword, std::string_view value) {
    if (tree != nullptr && !tree->open.empty())
        Put(tree, keyword, {KvfText{tree->StoreText(std::string(value))}});
}

void kvfPutParam(KvfTree* tree, std::string_view keyword, const char* value) {
    kvfPutParam(tree, keyword, value == nullptr ? std::string_view() : std::string_view(value));
}

void kvfPutParamFilename(KvfTree* tree, std::string_view keyword, std::string_view value) {
    if (tree != nullptr && !tree->open.empty())
        Put(tree, keyword, {KvfFileName{tree->StoreText(std::string(value))}});
}

void kvfPutListParam(KvfTree* tree, std::string_view keyword, std::string_view format,
                     std::initializer_list<int> values) {
    if (tree == nullptr || format.size() != values.size() ||
        format.find_first_not_of('i') != std::string_view::npos)
        return;
    kvfAddKeyword(tree, keyword);
    for (const int value : values)
        Append(tree, {value});
    tree->openKeyword = nullptr;
}

void kvfClose(KvfHandle* handle) {
    if (handle != nullptr)
        handle->reset();
}

} // namespace ryn
