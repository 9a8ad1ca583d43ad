#include "host/componentManager/stream.h"

#include <limits>
#include <new>
#include <utility>

#include "host/componentManager/componentManager.h"
#include "host/componentManager/devices.h"

namespace Ov {

namespace {

constexpr const char* source = "host/componentManager/stream";
constexpr std::int32_t lastColumn = 70;

/// The interface `*iid` of a loaded object, or the object itself.
RnRef<RnCastable> answering(const RnRef<RnCastable>& object, const RnUid* iid) {
    if (!iid) return object;
    RnCastable* found = object->getInterface(*iid);
    if (!found) found = RnTranslateInterface(object.get(), *iid);
    if (!found) RnCastable::throwBadCast();
    return RnRef<RnCastable>::adopt(found);
}

}  // namespace

RnStream::RnStream(RnPtr<RnBufferedIO> device, Form form, RnPostLoadList* postLoad)
    : _device(RnRef<RnBufferedIO>::share(device.get())), _form(form), _postLoad(postLoad) {
    if (!_device) RnCastable::throwBadCast();
}

RnStream::~RnStream() = default;

bool RnStream::isTextStream() const { return _form == Form::text; }
bool RnStream::isBinaryStream() const { return _form == Form::binary; }
int RnStream::computeLineNb() { return _device->lineFeeds() + 1; }

void RnStream::postLoad(RnPersistant* object) {
    if (_postLoad) {
        _postLoad->add(*object);
    } else {
        object->loadFinished();
    }
}

void RnStream::transfer(RnPostLoadList& list) {
    if (_postLoad) {
        _postLoad->take(list);
    } else {
        list.finish();
    }
}

void RnStream::endLine() {
    _device->endLine();
    column = 0;
    pendingSeparator = false;
}

void RnStream::writeItem(const wchar_t* text, int count) {
    if (pendingSeparator && column > lastColumn) {
        endLine();
    } else if (pendingSeparator) {
        _device->writeSeparator();
        ++column;
    }
    pendingSeparator = false;
    column += _device->writeChars(text, count);
}

void RnStream::skipPendingSeparator() {
    pendingSeparator = false;
    _device->skipSeparator(1);
}

RnStream& RnStream::operator<<(const RnCastable* object) {
    if (!object) return *this << 0U << 0U << 0U << 0U;
    const auto adapter = rnCast<RnPersistant>(const_cast<RnCastable*>(object));
    const RnUid& id = adapter->getClassId();
    *this << id.w0 << id.w1 << id.w2 << id.w3 << adapter->getVersion();
    if (isBinaryStream()) {
        saveContent(*adapter);
    } else {
        endLine();
        adapter->save(*this);
        // The object is an item, too: whatever it ended with, the next one stands apart from it.
        pendingSeparator = true;
    }
    return *this;
}

/// Saves into memory first, because the length stands before the content.
void RnStream::saveContent(RnPersistant& adapter) {
    const auto content = rnCreate<RnMemoryBuffer>();
    struct Redirection {
        Redirection(RnStream& stream, RnRef<RnBufferedIO> device)
            : _stream(stream), _outer(std::exchange(stream._device, std::move(device))) {
            reset();
        }
        ~Redirection() {
            _stream._device = std::move(_outer);
            reset();
        }
        void reset() {
            _stream.column = 0;
            _stream.pendingSeparator = false;
        }
        RnStream& _stream;
        RnRef<RnBufferedIO> _outer;
    };
    {
        const Redirection toMemory(*this, content);
        adapter.save(*this);
    }
    const std::string& bytes = content->bytes();
    if (!std::in_range<int>(bytes.size())) throw RnStreamEx::ExWriteError(source, __LINE__, "object stream");
    *this << static_cast<unsigned int>(bytes.size());
    const int count = static_cast<int>(bytes.size());
    if (_device->writeBytes(bytes.data(), count) != count) {
        throw RnStreamEx::ExWriteError(source, __LINE__, "object stream");
    }
}

RnRef<RnCastable> RnStream::readObject(const RnUid* iid, const wchar_t* name, const wchar_t* basePath) {
    RnUid id;
    *this >> id.w0 >> id.w1 >> id.w2 >> id.w3;
    if (id == RnUid{}) return {};
    int version = 0;
    *this >> version;
    const auto builder = rnCast<RnComponentManager>(RnGetComponentManager())->findBuilder(id);
    if (!builder) throw RnStreamEx::ExReadError(source, __LINE__, "object stream");
    const auto object = builder->create();
    if (!object) throw std::bad_alloc();
    const auto adapter = rnCast<RnPersistant>(object.get());
    if (version > adapter->getVersion()) throw RnStreamEx::ExReadError(source, __LINE__, "object stream");
    const bool loaded =
        isBinaryStream() ? loadContent(*adapter, name, basePath) : adapter->load(*this, 0, name, basePath);
    if (!loaded) return {};
    RnRef<RnCastable> result = answering(object, iid);
    postLoad(adapter.get());
    return result;
}

/// Reads the content and goes on to its end, of which a loader may leave a part.
bool RnStream::loadContent(RnPersistant& adapter, const wchar_t* name, const wchar_t* basePath) {
    unsigned int length = 0;
    *this >> length;
    const long start = _device->seek(0, 1);
    pendingSeparator = false;
    const bool loaded = adapter.load(*this, 0, name, basePath);
    pendingSeparator = false;
    constexpr long limit = std::numeric_limits<long>::max();
    if (start < 0 || std::cmp_greater(length, limit - start) ||
        _device->seek(start + static_cast<long>(length), 0) < 0) {
        throw RnStreamEx::ExReadError(source, __LINE__, "object stream");
    }
    return loaded;
}

}  // namespace Ov
