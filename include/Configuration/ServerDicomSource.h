// Configuration::ServerDicomSource: one DICOM sender known to the storage service provider.
//
// Element "ServerDicomSource"; keys in order, all strings, empty by default and required:
// "SourceName", "AeTitle", "Modality", "Manufacturer", "SerialNumber", "Model",
// "StudyDateRangeStart", "StudyDateRangeEnd" (the two bounds kept as configured, not parsed).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API ServerDicomSource : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(ServerDicomSource);

public:
    static constexpr const char SERVER_DICOM_SOURCE[] = "ServerDicomSource";

    // The source's name for people.
    const ACE_CString& getSourceName() const { return m_sourceName; }
    void setSourceName(const ACE_CString& name) { m_sourceName = name; }
    // The source's AE title.
    const ACE_CString& getAETitle() const { return m_aeTitle; }
    void setAETitle(const ACE_CString& title) { m_aeTitle = title; }
    // The modality it sends (CT, MR, ...).
    const ACE_CString& getModality() const { return m_modality; }
    void setModality(const ACE_CString& modality) { m_modality = modality; }
    // The device's manufacturer.
    const ACE_CString& getManufacturer() const { return m_manufacturer; }
    void setManufacturer(const ACE_CString& manufacturer) { m_manufacturer = manufacturer; }
    // The device's serial number.
    const ACE_CString& getSerialNumber() const { return m_serialNumber; }
    void setSerialNumber(const ACE_CString& number) { m_serialNumber = number; }
    // The device's model.
    const ACE_CString& getModel() const { return m_model; }
    void setModel(const ACE_CString& model) { m_model = model; }
    // First study date the source is trusted for, as configured.
    const ACE_CString& getStudyDateRangeStart() const { return m_studyDateRangeStart; }
    void setStudyDateRangeStart(const ACE_CString& date) { m_studyDateRangeStart = date; }
    // Last study date the source is trusted for, as configured.
    const ACE_CString& getStudyDateRangeEnd() const { return m_studyDateRangeEnd; }
    void setStudyDateRangeEnd(const ACE_CString& date) { m_studyDateRangeEnd = date; }

private:
    ACE_CString m_sourceName;
    ACE_CString m_aeTitle;
    ACE_CString m_modality;
    ACE_CString m_manufacturer;
    ACE_CString m_serialNumber;
    ACE_CString m_model;
    ACE_CString m_studyDateRangeStart;
    ACE_CString m_studyDateRangeEnd;
};

}  // namespace Configuration
