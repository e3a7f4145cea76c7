// The shared allowance of request-body bytes.
#include "BodyBudget.h"

namespace ConfigurationService {

BodyBudget::Grant::Grant(Grant&& other) noexcept
    : m_budget(other.m_budget), m_bytes(other.m_bytes) {
    other.m_budget = nullptr;
}

BodyBudget::Grant& BodyBudget::Grant::operator=(Grant&& other) noexcept {
    if (this != &other) {
        release();
        m_budget = other.m_budget;
        m_bytes = other.m_bytes;
        other.m_budget = nullptr;
    }
    return *this;
}

void BodyBudget::Grant::release() {
    if (m_budget != nullptr) {
        m_budget->m_used.fetch_sub(m_bytes, std::memory_order_relaxed);
        m_budget = nullptr;
    }
}

BodyBudget::Grant BodyBudget::reserve(std::size_t bytes) {
    std::size_t used = m_used.load(std::memory_order_relaxed);
    do {
        if (bytes > m_limit || used > m_limit - bytes) {
            return Grant();
        }
    } while (!m_used.compare_exchange_weak(used, used + bytes, std::memory_order_relaxed));
    return Grant(this, bytes);
}

}  // namespace ConfigurationService
