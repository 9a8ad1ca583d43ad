#pragma once

#include <optional>

#include "host/componentManager/stream.h"
#include "ovphoto/naturalLight.h"

// The saved forms of natural light: text, a line for each setting, and binary, an 88-byte block of an older record
// with trailers. Both start with a version and a release, which says what trailers there are: overrides of the
// sun's position and illuminance from 1 on, accuracy of sky shadows from 2 on (2 alone says there whether the sky
// casts shadows), both words of flags from 3 on. Version 1, release 3 is written; of a later release what 3 has is
// read.
//
// Units:    radians, but degrees for north, latitude and longitude in text; hours; lux.
// Binary:   little-endian, no field's size or order depends on the machine.
// Flags:    0x100 set: flag 3; 0x200 clear: flag 1 (casts shadows); 0x400 clear: flag 2.
// Errors:   reading answers nothing, after message 12896 around one of 12898 to 12924 and the line where it stopped;
//           for a binary form that ends early around 12898, with line 0. Writing text answers false, after message
//           13081 with the line's name, where a number is not finite; nothing is written then. What the stream's
//           device throws passes through.
// More:     docs/formats/naturalLight.md

namespace OvPhotometrics {

bool writeDaylightText(Ov::RnStream& out, const Ov::NaturalLightSettings& settings);
void writeDaylightBinary(Ov::RnStream& out, const Ov::NaturalLightSettings& settings);

/// Settings that the form's release does not have take their defaults. The version is not looked at.
std::optional<Ov::NaturalLightSettings> readDaylightText(Ov::RnStream& in);
/// Another version than 1 gives the defaults, without a look at what follows.
std::optional<Ov::NaturalLightSettings> readDaylightBinary(Ov::RnStream& in);

}  // namespace OvPhotometrics
