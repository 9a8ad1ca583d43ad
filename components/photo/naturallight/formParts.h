#pragma once

#include <cstdint>

#include "components/messageFile/typedMessage.h"
#include "ovphoto/naturalLight.h"

// What the text and the binary form of natural light share.

namespace OvPhotometrics {

constexpr int formVersion = 1;
constexpr int formRelease = 3;

/// The flags of sun and sky as words: 0x100 set for flag 3, 0x200 clear for flag 1 (casts shadows), 0x400 clear
/// for flag 2. Other bits are not used.
std::uint16_t sunFlagWord(const Ov::NaturalLightSettings& settings);
std::uint16_t skyFlagWord(const Ov::NaturalLightSettings& settings);
void setSunFlags(Ov::NaturalLightSettings& settings, unsigned word);
void setSkyFlags(Ov::NaturalLightSettings& settings, unsigned word);

/// Reports a message's text as it stands, and the line, inside message 12896. Without a catalogue the report is
/// the message's number.
void reportFormError(Ov::Message<> message, int line);

}  // namespace OvPhotometrics
