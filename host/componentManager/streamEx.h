#pragma once

#include "host/base/exBase.h"

namespace Ov {

/// A stream, or an object in it, cannot be read or written. Also caught as std::runtime_error.
class OVHOST_API RnStreamEx : public ExBase, public std::runtime_error {
public:
    /// `file`: source path of the throwing module without its extension; `what`: names the stream ("IES stream").
    RnStreamEx(const char* file, int line, const char* what);
    ~RnStreamEx() override;

    std::string getDetailedReason() const override;
    /// Source path of the throwing module.
    const char* getFile() const noexcept { return _file.c_str(); }
    /// Line there.
    int getLine() const noexcept { return getCode(); }

    class ExReadError;
    class ExWriteError;

private:
    std::string _file;
};

/// What is read is not there, not right or not to be held.
class OVHOST_API RnStreamEx::ExReadError : public RnStreamEx {
public:
    using RnStreamEx::RnStreamEx;
    ~ExReadError() override;
};

/// What is to be written cannot be written.
class OVHOST_API RnStreamEx::ExWriteError : public RnStreamEx {
public:
    using RnStreamEx::RnStreamEx;
    ~ExWriteError() override;
};

}  // namespace Ov
