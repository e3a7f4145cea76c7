// WorkflowAnswers: the texts of the user-workflow service's answers. Clients cut elements out by
// their exact marks, so every element is an opening tag without attributes, escaped text and a
// closing tag. Times are written "YYYY-MM-DDTHH:MM:SS.fffffffZ" (UTC). Stateless; thread-safe.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "Answer.h"
#include "workflow/WorkflowError.h"
#include "workflow/WorkflowRecords.h"

namespace ConfigurationService {
namespace Workflow {
namespace WorkflowAnswers {

// The service's text of a time.
std::string timeText(std::int64_t ms);
// Milliseconds since 1970 of a client's time text; the earliest time for "" and for the
// client's form of an unset time (year 0000); WorkflowError::bad for other unreadable text.
std::int64_t parseTime(const std::string& text);
// Appends <Node>...</Node>.
void node(Answer& answer, const Node& node);
// Appends <User>...</User>.
void user(Answer& answer, const User& user);
// Appends <ContactName>...</ContactName>.
void contactName(Answer& answer, const ContactName& name);
// <RetrievePreferencesResponse> holding, escaped, the XML text
// <Preferences><Preference><UserId/><Path/><Data/></Preference>...</Preferences>, so that the
// element's text as the client reads it is that XML text.
std::string preferences(const std::vector<Preference>& preferences);
// The error record of a failure.
std::string error(const WorkflowError& failure);

}  // namespace WorkflowAnswers
}  // namespace Workflow
}  // namespace ConfigurationService
