#include "apps/cli/kvf_json.h"

#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

namespace ryn::cli {

namespace {

Json JsonOfParameter(const KvfParam& parameter) {
    switch (kvfParamType(parameter)) {
    case KvfType::Int:
        return kvfParamInt(parameter);
    case KvfType::Float:
        return JsonOf(kvfParamFloat(parameter));
    case KvfType::Double:
        return JsonOf(kvfParamDouble(parameter));
    case KvfType::Bool:
        return kvfGetBool(&parameter);
    case KvfType::Text:
    case KvfType::FileName:
        return std::string(kvfParamText(parameter));
    }
    return nullptr;
}

/// The members of a section while it is walked. An ordered object of the library looks a name up by
/// walking all members, so that a section of a million keywords would never end.
class MemberList {
  public:
    void Add(const std::string& name, Json value) {
        const auto [place, isNew] = positions.try_emplace(name, members.size());
        if (isNew)
            members.push_back({name, {}});
        members[place->second].occurrences.push_back(std::move(value));
    }

    Json TakeObject() {
        Json object = Json::object();
        auto& content = object.get_ref<Json::object_t&>();
        content.reserve(members.size());
        for (Member& member : members)
            content.emplace_back(member.name, Combined(member.occurrences));
        return object;
    }

  private:
    struct Member {
        std::string name;
        std::vector<Json> occurrences;
    };

    static Json Combined(std::vector<Json>& occurrences) {
        return occurrences.size() == 1 ? std::move(occurrences.front())
                                       : Json(std::move(occurrences));
    }

    std::vector<Member> members;
    std::unordered_map<std::string, std::size_t> positions;
};

class JsonBuilder : public KvfVisitor {
  public:
    void BeginSection(std::string_view name) override {
        names.emplace_back(name);
        levels.emplace_back();
    }
    void EndSection() override {
        Json object = levels.back().TakeObject();
        levels.pop_back();
        levels.back().Add(names.back(), std::move(object));
        names.pop_back();
    }
    void BeginKeyword(std::string_view name, int /*parameterCount*/) override { keyword = name; }
    void Parameter(const KvfParam& parameter) override {
        parameters.push_back(JsonOfParameter(parameter));
    }
    void EndKeyword() override {
        levels.back().Add(keyword, parameters.size() == 1 ? std::move(parameters.front())
                                                          : Json(std::move(parameters)));
        parameters.clear();
    }
    Json TakeResult() { return levels.front().TakeObject(); }

  private:
    std::vector<std::string> names;
    std::vector<MemberList> levels = std::vector<MemberList>(1);
    std::string keyword;
    std::vector<Json> parameters;
};

} // namespace

Json JsonOfTree(const KvfTree* tree) {
    JsonBuilder builder;
    kvfVisit(tree, builder);
    return builder.TakeResult();
}

} // namespace ryn::cli
