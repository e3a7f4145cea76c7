// Fuzzes the two request parsers of the service with any body: the configuration operations'
// parser must give a request or BadRequest, the user-workflow parser a request or a 400
// WorkflowError, and every text the workflow parser keeps must be valid UTF-8 (the database
// holds UTF-8 only).
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>

#include "Request.h"
#include "workflow/WorkflowError.h"
#include "workflow/WorkflowRequest.h"

namespace {

using ConfigurationService::Workflow::asUtf8;

void requireUtf8(const std::string& text, const char* what) {
    if (asUtf8(text) != text) {
        std::fprintf(stderr, "the workflow parser kept a %s that is not UTF-8\n", what);
        std::abort();
    }
}

void parseConfigurationRequest(const std::string& input) {
    std::string body = input;
    try {
        const ConfigurationService::Request request = ConfigurationService::Request::parse(body);
        if (request.operation().empty()) {
            std::fprintf(stderr, "a request without an operation was accepted\n");
            std::abort();
        }
    } catch (const ConfigurationService::BadRequest&) {
    }
}

void parseWorkflowRequest(const std::string& body) {
    using ConfigurationService::Workflow::WorkflowRequest;
    try {
        const WorkflowRequest request = WorkflowRequest::parse(body);
        requireUtf8(request.operation, "operation");
        for (const auto* fields : {&request.parameters, &request.record}) {
            for (const auto& [name, text] : *fields) {
                requireUtf8(name, "name");
                requireUtf8(text, "text");
            }
        }
    } catch (const ConfigurationService::Workflow::WorkflowError& e) {
        if (e.status() != 400) {
            std::fprintf(stderr, "a malformed request gave status %d\n", e.status());
            std::abort();
        }
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string body(reinterpret_cast<const char*>(data), size);
    parseConfigurationRequest(body);
    parseWorkflowRequest(body);
    return 0;
}
