#include "components/module/registration.h"

#include "components/photo/cibse/photoWebCIBSE.h"
#include "components/photo/distributions/diffuse.h"
#include "components/photo/distributions/isotropic.h"
#include "components/photo/distributions/spotlight.h"
#include "components/photo/distributions/web.h"
#include "components/photo/ies/photoWebIES.h"
#include "components/photo/lid/component.h"
#include "components/photo/lid/importer.h"
#include "components/photo/naturallight/daylightData.h"
#include "components/photo/nimb/photoWebNIMB.h"
#include "components/photo/tbt/photoWebTBT.h"

namespace OvPhotometrics {

void registerBuilders() {
    BuilderTable& table = builderTable();
    table.add(immortal<CIBSEBuilder>());
    table.add(immortal<DaylightBuilder>());
    table.add(immortal<DiffuseBuilder>());
    table.add(immortal<WebBuilder>());
    table.add(immortal<IESBuilder>());
    table.add(immortal<IsotropicBuilder>());
    table.add(immortal<LidImporter>());
    lidComponent();
    table.add(immortal<NIMBBuilder>());
    table.add(immortal<SpotlightBuilder>());
    table.add(immortal<TBTBuilder>());
}

}  // namespace OvPhotometrics
