#pragma once

#include <concepts>
#include <exception>
#include <new>
#include <string>
#include <type_traits>

#include "frame/Error.h"

namespace tessel::frame {

/// Resume-next mode: a statement that fails is skipped and the next one runs. The failure stays pending until `Clear`;
/// a later success does not take it away, a later failure takes its place.
///
///     ResumeNext next;
///     next([&] { return row.SetSmallIcon(key); });        // a Status that failed, or a ControlError, becomes pending
///     if (next.Failed()) { next.Clear(); ... }
///     if (next.If([&] { return folder.IsRoot(); })) ...   // a failing test enters the branch
class ResumeNext {
  public:
    template <std::invocable F>
    void operator()(F&& statement) {
        Try([&] {
            if constexpr (std::is_same_v<std::invoke_result_t<F>, Status>) {
                if (const Status status = statement(); status.Failed()) Keep(status.Number(), ErrorText(status.Number()));
            } else {
                statement();
            }
        });
    }

    /// The value of an expression, or `otherwise` (what the variable held before) when it fails.
    template <std::invocable F>
    std::invoke_result_t<F> Value(F&& expression, std::invoke_result_t<F> otherwise) {
        Try([&] { otherwise = expression(); });
        return otherwise;
    }

    /// The test of an `If`: a test that fails goes on with the first statement inside.
    template <std::predicate F>
    bool If(F&& test) {
        bool result = true;
        Try([&] { result = test(); });
        return result;
    }

    bool Failed() const { return number_ != 0; }
    int Number() const { return number_; }
    const std::string& Description() const { return description_; }
    void Clear() { Keep(0, {}); }

  private:
    template <class F>
    void Try(F&& run) {
        try {
            run();
        } catch (const ControlError& error) {
            Keep(error.Number(), error.Description());
        } catch (const std::bad_alloc&) {
            Keep(errors::outOfMemory, ErrorText(errors::outOfMemory));
        }
    }
    void Keep(int number, std::string description) {
        number_ = number;
        description_ = std::move(description);
    }

    int number_ = 0;
    std::string description_;
};

}  // namespace tessel::frame
