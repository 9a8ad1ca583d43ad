#include "host/componentManager/castable.h"

#include <vector>

#include "components/support/immortal.h"
#include "host/componentManager/persistant.h"

namespace Ov {

namespace {

struct Translators {
    std::vector<RnTranslator> list;
};

/// Objects are cast until the process ends.
std::vector<RnTranslator>& translators() { return immortal<Translators>().list; }

}  // namespace

RnCastable::~RnCastable() = default;
void RnCastable::reserved() {}
long RnCastable::newReference() const { return 0; }
long RnCastable::release() const { return 0; }
void RnCastable::throwBadCast() { throw ExBadCast(); }

ExBadCast::ExBadCast() : ExBase("Bad cast: the object does not answer a required interface.") {}
ExBadCast::~ExBadCast() = default;
const char* ExBadCast::what() const noexcept { return getReason(); }

RnCastable* RnTranslateInterface(RnCastable* object, const RnUid& iid) {
    if (!object) return nullptr;
    for (RnTranslator translator : translators()) {
        if (RnCastable* found = translator(object, iid)) return found;
    }
    return nullptr;
}

void RnAddTranslator(RnTranslator translator) { translators().push_back(translator); }
void RnRemoveTranslator(RnTranslator translator) { std::erase(translators(), translator); }

void RnPersistant::loadFinished() {}

}  // namespace Ov
