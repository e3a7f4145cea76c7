#include "Vesk/SingleValue.h"

namespace Vesk {

std::unique_ptr<Value> SingleValue::clone() const {
    return std::make_unique<SingleValue>(*this);
}

bool SingleValue::equals(const Value& other) const {
    return other.kind() == Kind::Single &&
           value() == static_cast<const SingleValue&>(other).value();
}

}  // namespace Vesk
