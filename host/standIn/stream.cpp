#include "host/componentManager/stream.h"

#include <algorithm>
#include <limits>
#include <new>
#include <utility>

#include "components/support/devices.h"
#include "host/componentManager/componentManager.h"
#include "host/standIn/streamState.h"

namespace Ov {

namespace {

constexpr const char* source = "host/componentManager/stream";
constexpr int deepest = 256;  // objects in one another, which take a part of the program's stack each

RnBufferedIO& given(RnPtr<RnBufferedIO> device) {
    if (!device) RnCastable::throwBadCast();
    return *device;
}

/// One object more that stands in others, as long as it lives. Raises `Failure` where it is one too many.
template <class Failure>
class Nesting {
public:
    explicit Nesting(int& depth) : _depth(depth) {
        if (_depth == deepest) throw Failure(source, __LINE__, "object stream: too many objects in one another");
        ++_depth;
    }
    Nesting(const Nesting&) = delete;
    Nesting& operator=(const Nesting&) = delete;
    ~Nesting() { --_depth; }

private:
    int& _depth;
};

/// The interface `*iid` of an object, or the object itself.
RnRef<RnCastable> answering(const RnRef<RnCastable>& object, const RnUid* iid) {
    if (!iid) return object;
    RnCastable* found = object->getInterface(*iid);
    if (!found) found = RnTranslateInterface(object.get(), *iid);
    if (!found) RnCastable::throwBadCast();
    return RnRef<RnCastable>::adopt(found);
}

}  // namespace

RnStream::RnStream(RnPtr<RnBufferedIO> device, Form form, RnPostLoadList* postLoad)
    : _state(std::make_unique<State>(*this, given(device), form, postLoad)) {}

RnStream::~RnStream() = default;

bool RnStream::isTextStream() const { return _state->form == Form::text; }
bool RnStream::isBinaryStream() const { return _state->form == Form::binary; }

int RnStream::computeLineNb() {
    const long here = device().seek(0, 1);
    if (here < 0 || device().seek(0, 0) != 0) return 1;
    std::ptrdiff_t line = 1;
    char block[4096];
    int part = 1;
    for (long left = here; left > 0 && part > 0; left -= part) {
        part = rnReadBytes(device(), block, static_cast<int>(std::min<long>(left, sizeof block)));
        line += std::count(block, block + part, '\n');
    }
    device().seek(here, 0);
    return static_cast<int>(line);
}

void RnStream::postLoad(RnPersistant* object) {
    if (_state->postLoad) {
        _state->postLoad->add(*object);
    } else {
        object->loadFinished();
    }
}

void RnStream::transfer(RnPostLoadList& list) {
    if (_state->postLoad) {
        _state->postLoad->take(list);
    } else {
        list.finish();
    }
}

RnBufferedIO& RnStream::device() const { return _state->input.device(); }

void RnStream::State::writeBytes(std::string_view bytes) {
    text.resize(bytes.size());
    std::transform(bytes.begin(), bytes.end(), text.begin(),
                   [](char c) { return static_cast<wchar_t>(static_cast<unsigned char>(c)); });
    const int count = std::in_range<int>(bytes.size()) ? static_cast<int>(bytes.size()) : -1;
    if (count < 0 || input.device().writeChars(text.data(), count) != count)
        throw RnStreamEx::ExWriteError(source, __LINE__, "value stream");
}

RnStream& RnStream::operator<<(const RnCastable* object) {
    if (!object) return *this << 0U << 0U << 0U << 0U;
    const auto adapter = rnCast<RnPersistant>(const_cast<RnCastable*>(object));
    const Nesting<RnStreamEx::ExWriteError> nesting(_state->depth);
    const RnUid& id = adapter->getClassId();
    *this << id.w0 << id.w1 << id.w2 << id.w3 << adapter->getVersion();
    if (isBinaryStream()) {
        saveContent(*adapter);
    } else {
        endLine(*this);
        adapter->save(*this);
        // The object is an item, too: whatever it ended with, the next one stands apart from it.
        pendingSeparator = true;
    }
    return *this;
}

/// Saves into memory first, because the length stands before the content.
void RnStream::saveContent(RnPersistant& adapter) {
    // While it lives the stream writes into another device, from the start of a line.
    const auto content = rnCreate<RnMemoryBuffer>();
    struct Redirection {
        Redirection(RnStream& stream, RnBufferedIO& device)
            : _stream(stream), _outer(std::exchange(stream.state().input, RnCharInput(device))) {
            reset();
        }
        ~Redirection() {
            _stream.state().input = std::move(_outer);
            reset();
        }
        void reset() {
            _stream.column = 0;
            _stream.pendingSeparator = false;
        }
        RnStream& _stream;
        RnCharInput _outer;
    };

    // Save into memory, then write length and content.
    {
        const Redirection toMemory(*this, *content);
        adapter.save(*this);
    }
    const std::string& bytes = content->bytes();
    if (!std::in_range<int>(bytes.size())) throw RnStreamEx::ExWriteError(source, __LINE__, "object stream");
    *this << static_cast<unsigned int>(bytes.size());
    _state->writeBytes(bytes);
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
    answering(object, iid);  // an object that is not wanted is not loaded
    const Nesting<RnStreamEx::ExReadError> nesting(_state->depth);
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
    const long start = device().seek(0, 1);
    pendingSeparator = false;
    const bool loaded = adapter.load(*this, 0, name, basePath);
    pendingSeparator = false;
    constexpr long limit = std::numeric_limits<long>::max();
    if (start < 0 || std::cmp_greater(length, limit - start) ||
        device().seek(start + static_cast<long>(length), 0) < 0) {
        throw RnStreamEx::ExReadError(source, __LINE__, "object stream");
    }
    return loaded;
}

}  // namespace Ov
