#include "params/die_combination_kvf.h"

namespace ryn {

void CDieCombinationKvf::Write(KvfTree* file, const std::string& /*baseDirectory*/) {
    kvfPutParam(file, "ItemName", ItemName);
    kvfPutParam(file, "IsDefaultName", IsDefaultName);
    kvfPutParam(file, "DistributionType", DistributionType);
    kvfPutParam(file, "EstimationMethod", EstimationMethod);
    kvfPutParam(file, "LogNormalType", LogNormalType);
    kvfPutParam(file, "LogPearsonType", LogPearsonType);
    kvfPutParam(file, "EstimateLocationType", EstimateLocationType);
    kvfPutParam(file, "SampleCorrection", SampleCorrection);
}

void CDieCombinationKvf::Read(const KvfSection* section, const std::string& /*baseDirectory*/) {
    kvfGetParam(section, "ItemName", &ItemName, 1, 1);
    kvfGetParam(section, "IsDefaultName", &IsDefaultName, 1, 1);
    kvfGetParam(section, "DistributionType", &DistributionType, 1, 1);
    kvfGetParam(section, "EstimationMethod", &EstimationMethod, 1, 1);
    kvfGetParam(section, "LogNormalType", &LogNormalType, 1, 1);
    kvfGetParam(section, "LogPearsonType", &LogPearsonType, 1, 1);
    kvfGetParam(section, "EstimateLocationType", &EstimateLocationType, 1, 1);
    kvfGetParam(section, "SampleCorrection", &SampleCorrection, 1, 1);
}

} // namespace ryn
