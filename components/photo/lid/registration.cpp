#include "components/photo/lid/registration.h"

#include "components/photo/cibse/photoWebCIBSE.h"
#include "components/photo/distributions/isotropic.h"
#include "components/photo/distributions/web.h"
#include "components/photo/ies/photoWebIES.h"
#include "components/photo/lid/component.h"
#include "components/photo/naturallight/daylightData.h"

namespace OvPhotometrics {

void registerBuilders() {
    BuilderTable& table = builderTable();
    table.add(immortal<CIBSEBuilder>());
    table.add(immortal<DaylightBuilder>());
    table.add(immortal<WebBuilder>());
    table.add(immortal<IESBuilder>());
    table.add(immortal<IsotropicBuilder>());
    lidComponent();
}

}  // namespace OvPhotometrics
