#pragma once

#include "components/photo/naturallight/daylightData.h"
#include "components/support/devices.h"
#include "fuzz/fuzz.h"
#include "host/componentManager/stream.h"

namespace OvPhotometrics::fuzz {

using Form = Ov::RnStream::Form;

inline bool load(DaylightData& light, std::string_view bytes, Form form) {
    Ov::RnStream stream(Ov::rnCreate<Ov::RnMemoryBuffer>(bytes).get(), form);
    bool loaded = false;
    measured(bytes.size(),
             [&] { loaded = Ov::rnCast<Ov::RnPersistant>(&light)->load(stream, 0, nullptr, nullptr); });
    demand((takeMessages() == 0) == loaded, "what is refused has a message, and nothing else has");
    return loaded;
}

inline std::string saved(DaylightData& light, Form form) {
    const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
    Ov::RnStream stream(io.get(), form);
    Ov::rnCast<Ov::RnPersistant>(&light)->save(stream);
    return io->bytes();
}

/// Any bytes are refused with a message and change nothing, or give settings that light follows from and that are
/// saved and loaded again.
inline void trySettings(std::string_view bytes, Form form) {
    const auto light = Ov::rnCreate<DaylightData>();
    light->setDate(3, 1);
    const std::string before = saved(*light, Form::binary);
    if (!load(*light, bytes, form))
        return demand(saved(*light, Form::binary) == before, "what is refused changes nothing");
    const float up[] = {0, 0.6f, 0.8f};
    light->getSunriseSolarTime();
    light->getSkyIlluminance(up);
    light->getSkyLuminance(up);
    light->getSkyLuminanceAt(1, 2);
    light->getMonth();
    const std::string kept = saved(*light, form);
    demand(load(*light, kept, form), "what is saved is loaded");
    demand(form == Form::text || saved(*light, form) == kept, "what is saved is loaded exactly");
}

}  // namespace OvPhotometrics::fuzz
