#pragma once

#include "host/componentManager/bufferedIO.h"

namespace OvPhotometrics {

/// The class id of the webs that the host's importer makes of an input, whichever module builds them; none where no
/// format takes it. Keeps the position. Throws std::bad_alloc.
Ov::RnUid recognisedClass(Ov::RnBufferedIO& io);

}  // namespace OvPhotometrics
