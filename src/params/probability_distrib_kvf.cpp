#include "params/probability_distrib_kvf.h"

namespace ryn {

void CProbabilityDistribKvf::Write(KvfTree* file, const std::string& baseDirectory) {
    kvfAddSection(file, "ProbabilityDistribution");
    kvfPutParam(file, "NoOfItems", static_cast<int>(Combinations.size()));
    for (std::size_t i = 0; i < Combinations.size(); ++i) {
        kvfAddSection(file, "Item" + std::to_string(i + 1));
        Combinations[i]->Write(file, baseDirectory);
        kvfEndSection(file);
    }
    kvfEndSection(file);
}

void CProbabilityDistribKvf::Read(const KvfSection* enclosing, const std::string& baseDirectory) {
    Combinations.clear();
    const KvfSection* const section = kvfSectionByNameNum(enclosing, "ProbabilityDistribution", 1);
    for (int n = 1;; ++n) {
        const KvfSection* const item = kvfSectionByNameNum(section, "Item" + std::to_string(n), 1);
        if (item == nullptr)
            return;
        auto combination = std::make_unique<CDieCombinationKvf>(this);
        combination->Read(item, baseDirectory);
        Combinations.push_back(std::move(combination));
    }
}

} // namespace ryn
