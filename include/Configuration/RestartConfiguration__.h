// Configuration::RestartConfiguration__: the restart-schedule section ("Restart") of the
// per-machine system document: at which time of day, and every how many days, the machine's
// services are restarted.
//
// Keys in order, with defaults: "RestartTimeOfDay" (string, "02:00": 24-hour "HH:MM" local time,
// a quiet hour for an archive), "RestartNumberOfDaysBetween" (u32, 0: no scheduled restart, so a
// machine never restarts its services unless an administrator asks for it).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API RestartConfiguration__ : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(RestartConfiguration__);

public:
    // Time of day of the restart, "HH:MM".
    const ACE_CString& getRestartTimeOfDay() const { return m_restartTimeOfDay; }
    void setRestartTimeOfDay(const ACE_CString& value) { m_restartTimeOfDay = value; }
    // Days between two restarts; 0 means no scheduled restart.
    unsigned int getRestartNumberOfDaysBetween() const { return m_restartNumberOfDaysBetween; }
    void setRestartNumberOfDaysBetween(unsigned int value) { m_restartNumberOfDaysBetween = value; }

private:
    ACE_CString m_restartTimeOfDay{"02:00"};
    unsigned int m_restartNumberOfDaysBetween = 0;
};

}  // namespace Configuration
