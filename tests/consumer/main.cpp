#include <components/support/path.h>
#include <host/componentManager/componentManager.h>
#include <host/componentManager/importer.h>
#include <ovphoto/classIds.h>
#include <ovphoto/numberedExports.h>
#include <ovphoto/photoWebData.h>

#include <cstdio>

// Prints the candela of a file straight along its axis. MODULE is the path of the installed module.
int main(int count, char** arguments) {
    if (count != 2) return 2;
    const auto manager = Ov::rnCast<Ov::RnComponentManager>(Ov::RnGetComponentManager());
    const auto functions = OvPhotometrics::numberedFunctions(manager->loadModule(Ov::fromUtf8(MODULE).c_str()));
    if (functions.getTimeZoneCount() == 0) return 1;
    const auto object = manager->createObject(OvPhotometrics::classIds::importer);
    const auto importer = Ov::rnCast<Ov::RnImporter>(object.get());
    const auto imported = importer->import(Ov::fromUtf8(arguments[1]).c_str(), nullptr);
    const auto web = Ov::rnCast<Ov::RnPhotoWebData>(imported.get());
    std::printf("%.1f cd\n", web->getMaxCandela() * web->getIntensity(0, 0));
}
