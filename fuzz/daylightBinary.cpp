#include "fuzz/daylight.h"

void OvPhotometrics::fuzz::tryInput(std::string_view bytes) { trySettings(bytes, Form::binary); }
