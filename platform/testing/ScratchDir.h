// ScratchDir: a fresh temporary directory for one test, removed with everything in it at the end.
#pragma once

#include <string>

namespace Quorvex {
namespace Testing {

class ScratchDir {
public:
    ScratchDir();
    ~ScratchDir();
    ScratchDir(const ScratchDir&) = delete;
    ScratchDir& operator=(const ScratchDir&) = delete;

    const std::string& path() const { return m_path; }
    // path() + "/" + name
    std::string file(const std::string& name) const { return m_path + "/" + name; }

private:
    std::string m_path;
};

}  // namespace Testing
}  // namespace Quorvex
