// Configuration::PrefetchConfiguration__: when the query module fetches prior studies ahead of
// need. A section of the query module's document "KelQuery" (its child "Prefetch").
//
// Element "Prefetch"; keys in order, all required: "TreatOtherIdsAsPrimary" (flag, false),
// "PrefetchOutsideNormalBusinessHours" (flag, true), "PrefetchDaysBefore" (unsigned int, 2),
// "PrefetchMaxRetries" (unsigned int, 5), "PrefetchEnabled" (flag, false).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API PrefetchConfiguration__ : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(PrefetchConfiguration__);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "Prefetch";

    // Whether other patient ids count as primary ones when looking for priors.
    bool getTreatOtherIdsAsPrimary() const { return m_treatOtherIdsAsPrimary; }
    void setTreatOtherIdsAsPrimary(bool treat) { m_treatOtherIdsAsPrimary = treat; }
    // Whether prefetching may run outside normal business hours.
    bool getPrefetchOutsideNormalBusinessHours() const { return m_outsideBusinessHours; }
    void setPrefetchOutsideNormalBusinessHours(bool allowed) { m_outsideBusinessHours = allowed; }
    // How many days ahead of the appointment priors are fetched.
    unsigned int getPrefetchDaysBefore() const { return m_daysBefore; }
    void setPrefetchDaysBefore(unsigned int days) { m_daysBefore = days; }
    // How often a failed prefetch is retried.
    unsigned int getPrefetchMaxRetries() const { return m_maxRetries; }
    void setPrefetchMaxRetries(unsigned int count) { m_maxRetries = count; }
    // Whether prefetching runs.
    bool getPrefetchEnabled() const { return m_enabled; }
    void setPrefetchEnabled(bool enabled) { m_enabled = enabled; }

private:
    bool m_treatOtherIdsAsPrimary = false;
    bool m_outsideBusinessHours = true;
    unsigned int m_daysBefore = 2;
    unsigned int m_maxRetries = 5;
    bool m_enabled = false;
};

}  // namespace Configuration
