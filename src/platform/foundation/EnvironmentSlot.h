#pragma once

#include <atomic>
#include <cstdint>
#include <functional>
#include <mutex>
#include <optional>
#include <utility>

namespace orvo {

/// One thing of the process that a test, or a command-line option, must be able to turn. The
/// default is made on first use. Reading and overriding are safe from any thread; an override holds
/// for the whole process while its scope lives.
template <class T>
class EnvironmentSlot {
public:
    /// Puts the earlier value back at its end. Overrides of one slot end in the reverse order of
    /// their beginning.
    class [[nodiscard]] Override {
    public:
        Override(EnvironmentSlot& slot, T value)
            : _slot(&slot)
            , _earlier(slot.exchange(std::move(value))) {}
        Override(const Override&) = delete;
        Override& operator=(const Override&) = delete;
        Override(Override&& other) noexcept
            : _slot(std::exchange(other._slot, nullptr))
            , _earlier(std::move(other._earlier)) {}
        Override& operator=(Override&&) = delete;
        ~Override() {
            if (_slot)
                _slot->exchange(std::move(_earlier));
        }

    private:
        EnvironmentSlot* _slot;
        std::optional<T> _earlier;
    };

    explicit EnvironmentSlot(std::function<T()> makeDefault)
        : _makeDefault(std::move(makeDefault)) {}

    [[nodiscard]] T get() {
        const std::lock_guard lock(_mutex);
        if (!_value)
            _value = _makeDefault();
        return *_value;
    }

    /// Above 0, and another number after every change: whoever keeps something made from the value
    /// reads this before the value, and makes it again when the number is another.
    [[nodiscard]] std::uint64_t generation() const noexcept {
        return _generation.load(std::memory_order_acquire);
    }

    /// Holds until the answered scope ends.
    Override overrideWith(T value) { return Override(*this, std::move(value)); }

    /// For `main`, from a command-line option: holds for the rest of the process.
    void set(T value) { exchange(std::move(value)); }

private:
    std::optional<T> exchange(std::optional<T> value) {
        const std::lock_guard lock(_mutex);
        std::swap(_value, value);
        _generation.fetch_add(1, std::memory_order_release);
        return value;
    }

    std::mutex _mutex;
    std::function<T()> _makeDefault;
    std::optional<T> _value;
    std::atomic<std::uint64_t> _generation = 1;
};

} // namespace orvo
