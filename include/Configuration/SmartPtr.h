// SmartPtr: the shared owning pointer through which records made by a static Create() are handed
// out (ErrorData, the user-workflow records). Copies share ownership; the count is thread-safe.
#pragma once

#include <memory>

namespace Configuration {

template <class T>
using SmartPtr = std::shared_ptr<T>;

}  // namespace Configuration
