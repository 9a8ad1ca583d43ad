#include "host/base/exBase.h"

namespace Ov {

namespace {

const char* orEmpty(const char* text) { return text ? text : ""; }

}  // namespace

ExBase::ExBase(const char* reason, int code) : _reason(orEmpty(reason)), _code(code) {}
ExBase::ExBase(const ExBase&) = default;
ExBase& ExBase::operator=(const ExBase&) = default;
ExBase::~ExBase() = default;

std::string ExBase::getDetailedReason() const {
    return _code == 0 ? _reason : _reason + " (" + std::to_string(_code) + ")";
}

void ExBase::setReason(const char* reason) { _reason = orEmpty(reason); }

ExAssertion::ExAssertion(const char* expression, const char* file, int line)
    : ExBase(expression, line), std::logic_error(orEmpty(expression)), _file(orEmpty(file)) {}
ExAssertion::~ExAssertion() = default;

std::string ExAssertion::getDetailedReason() const {
    return std::string("Assertion failed: ") + getReason() + " (" + _file + ", line " + std::to_string(getCode()) +
           ")";
}

void Assertions::throwAssertionFailed(const char* expression, const char* file, int line) {
    throw ExAssertion(expression, file, line);
}

}  // namespace Ov
