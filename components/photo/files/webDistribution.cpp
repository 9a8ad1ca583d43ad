#include "components/photo/files/webDistribution.h"

#include "host/componentManager/componentManager.h"
#include "ovphoto/classIds.h"

namespace OvPhotometrics {

RnRef<Ov::RnWebIntensityDist> makeWebDistribution(Ov::RnPhotoWebData& web) {
    const auto manager = Ov::rnCast<Ov::RnComponentManager>(Ov::RnGetComponentManager());
    const auto object = manager->createObject(classIds::webDistribution);
    auto distribution = Ov::rnCast<Ov::RnWebIntensityDist>(object.get());
    distribution->setWeb(&web);
    distribution->setFlux(web.getLumens());
    return distribution;
}

RnRef<Ov::RnPhotoWebData> webOf(Ov::RnIntensityDist& distribution) {
    const auto holder = Ov::rnQuery<Ov::RnWebIntensityDist>(&distribution);
    return holder ? Ov::rnQuery<Ov::RnPhotoWebData>(holder->getWeb()) : RnRef<Ov::RnPhotoWebData>();
}

}  // namespace OvPhotometrics
