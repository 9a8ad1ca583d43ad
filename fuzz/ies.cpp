#include "fuzz/web.h"

void OvPhotometrics::fuzz::tryInput(std::string_view bytes) { tryFile<IesFormat>(bytes); }
