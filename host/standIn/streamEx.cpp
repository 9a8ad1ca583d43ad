#include "host/componentManager/streamEx.h"

namespace Ov {

RnStreamEx::RnStreamEx(const char* file, int line, const char* what)
    : ExBase(what, line), std::runtime_error(what ? what : ""), _file(file ? file : "") {}
RnStreamEx::~RnStreamEx() = default;

std::string RnStreamEx::getDetailedReason() const {
    return std::string(getReason()) + " (" + _file + ", line " + std::to_string(getLine()) + ")";
}

RnStreamEx::ExReadError::~ExReadError() = default;
RnStreamEx::ExWriteError::~ExWriteError() = default;

}  // namespace Ov
