#include "Vesk/Value.h"

#include "NodePool.h"

namespace Vesk {

void* Value::operator new(std::size_t size) {
    return NodePool::allocate(size);
}

void Value::operator delete(void* block, std::size_t size) noexcept {
    NodePool::deallocate(block, size);
}

}  // namespace Vesk
