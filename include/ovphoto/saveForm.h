#pragma once

#include "host/componentManager/castable.h"

namespace Ov {

/// How the module's webs save themselves into a host's streams, inside a distribution or alone. The builder of its
/// web distributions has it:
///
///     rnCast<RnWebSaveForm>(manager->findBuilder(classIds::webDistribution).get())->setFaithful(true);
///
/// Without it (as it is when the module is loaded) webs of IES and CIBSE are saved with two decimals and without their
/// orientation and peak. With it, those of every format that has PhotoFormatTraits::holdsOrientation keep all angles and
/// the orientation as they are, and peak, lumens and values within 1e-5 of the peak, so that a scene gives the same
/// light when it is loaded again. Webs of other formats, NIMB and TBT, are saved as they always are. docs/embedding.md
/// lists what is kept.
///
/// Loading takes both forms, whatever is set.
///
/// Errors:   a web that its format cannot hold so, such as one with angles that its reader takes only for being close
///           to others, is not saved: message 13083 and RnStreamEx::ExWriteError, and nothing of the web is written.
///           Without the setting it can be saved.
/// Threads:  any number, at any time. It counts for webs whose saving begins afterwards.
class RnWebSaveForm : public RnCastable {
public:
    /// Id of the interface.
    static constexpr RnUid iid{0x7c1e9f22, 0x4a5b11ef, 0x9c6e0b62, 0x5d83a4f7};

    /// Whether webs are saved faithfully.
    virtual bool isFaithful() const = 0;
    /// False when the module is loaded.
    virtual void setFaithful(bool faithful) = 0;
};

}  // namespace Ov
