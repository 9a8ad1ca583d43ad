#pragma once

#include <type_traits>
#include <utility>

namespace Ov {

/// What the visitors of a walk answer.
struct RnEnum {
    /// 0 lets a walk go on; anything else stops it and is passed back to whoever started it.
    enum Action : int { goOn = 0, stop = 1 };
};

/// Visitor of the items of a walk. `finish` is called once after the last item, not after a stop.
template <class T>
class RnEnumerator {
public:
    /// Visits one item.
    virtual RnEnum::Action visit(T item) = 0;
    /// All items have been visited.
    virtual RnEnum::Action finish() { return RnEnum::goOn; }

protected:
    ~RnEnumerator() = default;
};

/// Visitor that calls a function of the item: returning nothing goes on, returning RnEnum::Action decides.
template <class T, class F>
class RnVisitor final : public RnEnumerator<T> {
public:
    /// Visits by calling `function`.
    explicit RnVisitor(F function) : _function(std::move(function)) {}
    /// Calls the function.
    RnEnum::Action visit(T item) override {
        if constexpr (std::is_void_v<std::invoke_result_t<F&, T>>) {
            _function(item);
            return RnEnum::goOn;
        } else {
            return _function(item);
        }
    }

private:
    F _function;
};

/// A visitor of items of type `T` that calls `function`.
template <class T, class F>
RnVisitor<T, F> rnVisitor(F function) {
    return RnVisitor<T, F>(std::move(function));
}

}  // namespace Ov
