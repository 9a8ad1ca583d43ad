#pragma once

#include <cstdarg>

namespace Ov {

/// The open arguments of a variadic function, to be passed on and taken one by one.
struct Arguments {
    std::va_list list;

    template <class T>
    T next() {
        return va_arg(list, T);
    }
};

}  // namespace Ov
