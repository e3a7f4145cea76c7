// Configuration::ApplicationLocationConfiguration: the site-wide document "ApplicationLocation":
// which solution is installed, its products and its applications, and so where the binaries of a
// process lie.
//
// Element "ApplicationLocation" with the children "Solution" (SolutionDefinition),
// "ProductDefinitions" (ProductDefinitions) and "AppDefinitions" (ApplicationDefinitions), written
// and read in that order, each at its defaults (empty) in a new document.
//
// getProductBinPath follows a process's application to its product and reads the environment
// variable that the product's "BinaryPath" names ("QX_BIN" and "%QX_BIN%" name the same
// variable; the value is never expanded further). Every failure gives an empty text and one
// critical log line. The environment is read through Quorvex::CurrentMachine().
// Plain value owned by its caller; not thread-safe (getProductBinPath only reads).
#pragma once

#include <ace/SString.h>

#include <cstddef>

#include "Configuration/ApplicationDefinitions.h"
#include "Configuration/ConfigurationClass.h"
#include "Configuration/ProductDefinitions.h"
#include "Configuration/SolutionDefinition.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API ApplicationLocationConfiguration
    : public TypedConfigDoc<ApplicationLocationConfiguration> {
    CONFIGURATION_CLASS(ApplicationLocationConfiguration);

public:
    // Bytes of the environment look-up buffer: a value needs fewer (its terminating null
    // included), so a value of 2048 characters or more counts as not set.
    static constexpr std::size_t kEnvironmentBufferSize = 2048;

    // The site-wide document "ApplicationLocation", empty.
    ApplicationLocationConfiguration();

    // The installed solution.
    const SolutionDefinition& getSolutionDefinition() const { return m_solution; }
    void setSolutionDefinition(const SolutionDefinition& value) { m_solution = value; }
    // The applications.
    const ApplicationDefinitions& getApplicationDefinitions() const { return m_applications; }
    void setApplicationDefinitions(const ApplicationDefinitions& value) { m_applications = value; }
    // The products.
    const ProductDefinitions& getProductDefinitions() const { return m_products; }
    void setProductDefinitions(const ProductDefinitions& value) { m_products = value; }

    // The binary folder of the named process, from the environment variable its product names;
    // empty (and a critical log line) when any step fails.
    ACE_CString getProductBinPath(const ACE_CString& processName) const;

private:
    SolutionDefinition m_solution;
    ApplicationDefinitions m_applications;
    ProductDefinitions m_products;
};

}  // namespace Configuration
