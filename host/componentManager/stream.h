#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include "host/componentManager/bufferedIO.h"
#include "host/componentManager/postLoadList.h"
#include "host/componentManager/streamEx.h"

namespace Ov {

/// A stream of values, formatted text and whole objects over a device, in text or in binary form.
///
/// Text form: values stand as decimal text with one separator between them; lines break after column 70. Numbers
/// read back exactly; characters stand as numbers, bool as 0 or 1, a string between quotes with `\"`, `\\` and
/// `\uXXXX`.
/// Binary form: values stand little-endian in fixed widths (long as 32 bits, wchar_t as 16, bool as one byte,
/// a string as a 32-bit length and that many UTF-16 units).
/// Formatted text is the same in both forms, one byte a character.
///
/// Errors: a value that is missing or cannot be held raises RnStreamEx::ExReadError, one that cannot be written
/// RnStreamEx::ExWriteError. The formatted operations return counts instead.
/// Threads: one at a time for a stream and its device.
class OVHOST_API RnStream {
public:
    /// How values stand in the device.
    enum class Form { text, binary };

    /// Reads and writes through `device`, which it keeps. Loaded objects go to `postLoad`, or, without a list,
    /// hear of the end of their load at once.
    RnStream(RnPtr<RnBufferedIO> device, Form form, RnPostLoadList* postLoad = nullptr);
    RnStream(const RnStream&) = delete;
    RnStream& operator=(const RnStream&) = delete;

    virtual ~RnStream();

    /// @{
    /// The form.
    virtual bool isTextStream() const;
    virtual bool isBinaryStream() const;
    /// @}

    /// `object` has been loaded and wants to hear when all are.
    virtual void postLoad(RnPersistant* object);
    /// Hands the waiting objects of `list` on to this stream's own list.
    virtual void transfer(RnPostLoadList& list);
    /// Line of the current position: the line feeds from the start of the device to there, which are counted by
    /// reading them again, plus one. 1 on a device that cannot go back.
    virtual int computeLineNb();

    // Four groups over fifteen types, in this order of types.
// clang-format off
#define OV_STREAM_TYPES(X) \
    X(unsigned long long) X(long long) X(std::wstring) X(double) X(float) X(bool) X(unsigned long) X(long) \
    X(unsigned int) X(int) X(unsigned short) X(short) X(unsigned char) X(wchar_t) X(char)
// clang-format on
#define OV_STREAM_WRITE(T) virtual void write(const T& value, int count);
#define OV_STREAM_INSERT(T) virtual RnStream& operator<<(T value);
#define OV_STREAM_READ(T) virtual int read(T& value, int count);
#define OV_STREAM_EXTRACT(T) virtual RnStream& operator>>(T& value);

    /// @{
    /// Values: one, or the `count` that stand from `value` on. `read` gives the number read, which is `count`.
    OV_STREAM_TYPES(OV_STREAM_WRITE)
    OV_STREAM_TYPES(OV_STREAM_INSERT)
    OV_STREAM_TYPES(OV_STREAM_READ)
    OV_STREAM_TYPES(OV_STREAM_EXTRACT)
    /// @}
#undef OV_STREAM_WRITE
#undef OV_STREAM_INSERT
#undef OV_STREAM_READ
#undef OV_STREAM_EXTRACT

    /// @{
    /// Formatted text as wide printf and scanf know it, with these fixed meanings on every platform: %s and %[
    /// are wide strings, %hd and %hx 16 bits, %d, %ld, %u and %x 32 bits, %n int; reading, %g, %f and %e are float
    /// and %lg, %lf and %le double. Independent of the process's locale, and exact. Only decimal numbers convert:
    /// no "nan", "inf" or hexadecimal floats, and no number that its type cannot hold (one too small is 0).
    /// Writing returns the number of characters, reading the number of conversions, or -1 when the input ends
    /// before the first. Neither touches `column`; writing leaves `pendingSeparator` alone, reading consumes a
    /// pending separator first.
    virtual int formattedWrite(const wchar_t* format, ...);
    virtual int formattedRead(const wchar_t* format, ...);
    /// @}

    /// Writes a whole object: its class id and version, then what its persistence adapter saves. Null is written
    /// as such. Raises ExBadCast for an object that cannot be saved, and ExWriteError where more than 256 objects
    /// stand in one another. In text form what the adapter saves starts on a fresh line; in binary form its length
    /// stands before it.
    RnStream& operator<<(const RnCastable* object);
    /// Reads an object that the operator wrote: creates it by its class id, loads it with `name` and `basePath`,
    /// and gives it as the interface `*iid` (null: as it is). A null object, or one whose load answered false,
    /// gives null. A class that nobody knows and more than 256 objects in one another raise ExReadError, a missing
    /// interface ExBadCast; none of the object has been loaded then.
    RnRef<RnCastable> readObject(const RnUid* iid, const wchar_t* name = nullptr,
                                 const wchar_t* basePath = nullptr);

    /// The device, without a new reference.
    RnBufferedIO& device() const;

    /// @{
    /// Characters on the current output line, and whether the last item leaves a separator due. The text readers
    /// and writers of formats keep both themselves where they go to the device directly.
    std::int32_t column = 0;
    bool pendingSeparator = false;
    /// @}

    /// @cond
    struct State;
    State& state() const { return *_state; }
    /// @endcond

private:
    void saveContent(RnPersistant& adapter);
    bool loadContent(RnPersistant& adapter, const wchar_t* name, const wchar_t* basePath);

    std::unique_ptr<State> _state;
};

}  // namespace Ov
