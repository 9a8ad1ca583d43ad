#pragma once

#include "host/componentManager/castable.h"

namespace Ov {

class RnStream;

/// Saves an object into a stream and loads it back. Data classes hand out an adapter that answers this interface.
class OVHOST_API RnPersistant : public RnCastable {
public:
    /// Id of the interface.
    [[gnu::used]] static constexpr RnUid iid{0x81c8df24, 0xa78111d1, 0x988a4445, 0x53540000};

    /// Class id of the object, the same as its builder's: streams store objects by it.
    virtual const RnUid& getClassId() const = 0;
    /// Of the saved form; streams refuse to load newer ones.
    virtual int getVersion() const = 0;
    /// Throws RnStreamEx::ExWriteError when the object cannot be written.
    virtual void save(RnStream& stream) = 0;
    /// Reads what `save` wrote. `name` names the object, `basePath` is the folder that relative file names start
    /// from; both may be null. True, or an RnStreamEx::ExReadError, or false after a reported message; whichever
    /// way it fails the object is as it was.
    virtual bool load(RnStream& stream, int context, const wchar_t* name, const wchar_t* basePath) = 0;
    /// Called once when every object of a stream has been loaded.
    virtual void loadFinished();
};

}  // namespace Ov
