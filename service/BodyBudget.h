// BodyBudget: the bytes of request bodies that the HTTP front may hold at once, over all
// connections. A body is admitted only when its declared size (or, without one, the most it may
// grow to) fits what is left, so that many large requests at the same time cannot take the
// machine's memory. A Grant holds admitted bytes and gives them back when destroyed. The budget
// must outlive its grants. All calls are thread-safe.
#pragma once

#include <atomic>
#include <cstddef>

namespace ConfigurationService {

class BodyBudget {
public:
    // Admitted bytes; empty when refused. Movable, not copyable.
    class Grant {
    public:
        Grant() = default;
        Grant(Grant&& other) noexcept;
        Grant& operator=(Grant&& other) noexcept;
        Grant(const Grant&) = delete;
        Grant& operator=(const Grant&) = delete;
        ~Grant() { release(); }

        // Whether the bytes were admitted.
        explicit operator bool() const { return m_budget != nullptr; }
        // Gives the bytes back now.
        void release();

    private:
        friend class BodyBudget;
        Grant(BodyBudget* budget, std::size_t bytes) : m_budget(budget), m_bytes(bytes) {}

        BodyBudget* m_budget = nullptr;
        std::size_t m_bytes = 0;
    };

    explicit BodyBudget(std::size_t limit) : m_limit(limit) {}
    BodyBudget(const BodyBudget&) = delete;
    BodyBudget& operator=(const BodyBudget&) = delete;

    // Admits bytes, or returns an empty grant when they do not fit.
    Grant reserve(std::size_t bytes);
    // Bytes admitted now.
    std::size_t used() const { return m_used.load(std::memory_order_relaxed); }

private:
    const std::size_t m_limit;
    std::atomic<std::size_t> m_used{0};
};

}  // namespace ConfigurationService
