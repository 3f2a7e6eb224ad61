#include "svymath/alignments/vertical_types.h"

#include "svymath/foundation/constants.h"

CLsInfo::CLsInfo()
    : ipChainage(svy_math::undefinedValue()),
      ipHeight(svy_math::undefinedValue()),
      curveLength(svy_math::undefinedValue()),
      curveStartChainage(svy_math::undefinedValue()),
      radius(svy_math::undefinedValue()) {}

CLsInfo::CLsInfo(double chainage, double height, double length, double startChainage, double r)
    : ipChainage(chainage), ipHeight(height), curveLength(length), curveStartChainage(startChainage), radius(r) {}

bool CLsInfo::isok() const { return !svy_math::isUndefined(ipChainage) && !svy_math::isUndefined(ipHeight); }
