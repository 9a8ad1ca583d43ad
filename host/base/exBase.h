#pragma once

#include <stdexcept>
#include <string>

#include "host/base/hostApi.h"

namespace Ov {

/// Base of every exception that crosses between the host and its modules. It derives from nothing, so that a
/// class can also be a standard exception and still be caught as either.
class OVHOST_API ExBase {
public:
    /// `reason`: what went wrong, for the user; `code`: 0, or where it was raised (a line number).
    explicit ExBase(const char* reason, int code = 0);

    /// @{
    /// Copies reason and code.
    ExBase(const ExBase&);
    ExBase& operator=(const ExBase&);
    /// @}

    virtual ~ExBase();

    /// What went wrong, for the user.
    const char* getReason() const noexcept { return _reason.c_str(); }
    /// The reason with what else is known: here the code, in derived classes the source path.
    virtual std::string getDetailedReason() const;
    /// Says something else about what went wrong.
    void setReason(const char* reason);
    /// 0, or the line that it was raised at.
    int getCode() const noexcept { return _code; }

private:
    std::string _reason;
    int _code;
};

/// A failed assertion of the host: the expression that did not hold and where it stands.
class OVHOST_API ExAssertion : public ExBase, public std::logic_error {
public:
    /// `expression` did not hold in `line` of `file`.
    ExAssertion(const char* expression, const char* file, int line);
    ~ExAssertion() override;

    std::string getDetailedReason() const override;

private:
    std::string _file;
};

namespace Assertions {
/// Raises ExAssertion; the reason is the expression's text.
[[noreturn]] OVHOST_API void throwAssertionFailed(const char* expression, const char* file, int line);
}  // namespace Assertions

namespace FloatUtil {
/// The value without its sign; that of -0 stays.
inline float abs(float value) { return value < 0 ? -value : value; }
}  // namespace FloatUtil

}  // namespace Ov
