// RequestRouting: how the HTTP front places a request before it runs it: the path a request
// target names (origin form "/p?q" or absolute form "http://host:port/p?q"), and whether an
// operation answers from memory at once, so that it may run on a socket thread, or may write to
// disk or wait for the master, so that it runs on the worker pool. Stateless; thread-safe.
#pragma once

#include <cstddef>
#include <string>

namespace ConfigurationService {

namespace RequestRouting {

// The one path the service answers.
constexpr const char* kServicePath = "/Sundrel/ConfigurationService/ConfigurationService.ashx";

// Bodies up to this size may run on a socket thread.
constexpr std::size_t kQuickBodyBytes = 16 * 1024;

// The path of a request target without query or fragment; the target itself when it has
// neither form (for example "*").
std::string path(const std::string& target);

// The name of the root element of an XML request body, or "" when none is found at its start.
std::string rootName(const std::string& body);

// Whether a request with this body answers from memory without waiting (small reads only).
bool isQuick(const std::string& body);

}  // namespace RequestRouting

}  // namespace ConfigurationService
