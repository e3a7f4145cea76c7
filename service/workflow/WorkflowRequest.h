// WorkflowRequest: one parsed request of the user-workflow service:
// <Message><Operation><param>text</param>...<node xmlns="..."><Node><Field>text</Field>...</Node>
// </node></Operation></Message>. Parameters and record fields are kept by name (an element the
// client left out is absent). A name or text that is not valid UTF-8 is taken as Latin-1 (the
// clients' local code page) and kept as UTF-8, so that every text the service stores or echoes in
// an answer is UTF-8. A plain value.
#pragma once

#include <string>

#include "workflow/WorkflowRecords.h"

namespace ConfigurationService {
namespace Workflow {

struct WorkflowRequest {
    std::string operation;
    Fields parameters;
    Fields record;  // the fields of the record in a "node" or "user" wrapper

    // Parses body; throws WorkflowError (400) when it is not such a message.
    static WorkflowRequest parse(const std::string& body);
    // A parameter's text, empty when absent.
    std::string parameter(const char* name) const;
};

// text as UTF-8: unchanged when it is valid UTF-8, else each byte read as Latin-1.
std::string asUtf8(const std::string& text);

}  // namespace Workflow
}  // namespace ConfigurationService
