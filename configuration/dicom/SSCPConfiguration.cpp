// The storage service provider's document and its known sources.
#include "Configuration/SSCPConfiguration.h"

#include "Configuration/DocumentNames.h"
#include "ListReserve.h"
#include "Quorvex/Log.h"
#include "ReadOrder.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

// The sources' list: an absent child, or one the element library cannot read as a list, makes
// the read incomplete without ending it (no sources at all is a valid configuration).
template <class F>
struct Tolerated : Fields::Form {
    F inner;
    bool read(const Fields::In& in, const char* key) const {
        try {
            return inner.read(in, key);
        } catch (const Vesk::TrelException&) {
            return false;
        }
    }
    void write(Fields::Out& out, const char* key) const { inner.write(out, key); }
    template <class C>
    void compare(C& c) const {
        inner.compare(c);
    }
};

template <class F>
Tolerated<F> tolerated(F inner) {
    return Tolerated<F>{{}, inner};
}

constexpr const char kSources[] = "DicomSources";

}  // namespace

template <class Self, class Io>
void ServerDicomSource::fields(Self& self, Io& io) {
    io("SourceName", self.m_sourceName);
    io("AeTitle", self.m_aeTitle);
    io("Modality", self.m_modality);
    io("Manufacturer", self.m_manufacturer);
    io("SerialNumber", self.m_serialNumber);
    io("Model", self.m_model);
    io("StudyDateRangeStart", self.m_studyDateRangeStart);
    io("StudyDateRangeEnd", self.m_studyDateRangeEnd);
}

CONFIGURATION_DEFINE(ServerDicomSource, ServerDicomSource::SERVER_DICOM_SOURCE,
                     Fields::FailureForm::Failed)

template <class Self, class Io>
void SSCPConfiguration::fields(Self& self, Io& io) {
    const auto filter = Fields::listValue(self.m_suidFilter);
    const auto sources = tolerated(Fields::wrapped(ServerDicomSource::SERVER_DICOM_SOURCE,
                                                   self.m_sources, Fields::DropFailed));
    io("NormalAETitle", self.m_normalAETitle);
    io("HighPriorityAETitle", self.m_highPriorityAETitle);
    io("Port", self.m_port);
    io("LargeImageSize", self.m_largeImageSize);
    io("MergeLibraryMinimumCallbackDataSize", self.m_minimumCallbackDataSize);
    io("ForceAssociation", self.m_forceAssociation);
    io("OverwriteAssociationTags", self.m_overwriteAssociationTags);
    io("CatchUnhandledExceptions", self.m_catchUnhandledExceptions);
    io("MergeLibraryMaxPduLength", self.m_maxPduLength);
    io("GenerateSuid", self.m_generateSuid);
    io("AppendStudyDateToGeneratedSuid", self.m_appendStudyDate);
    if constexpr (readingFields<Io>) {
        io("SuidGenerationAETitleFilter", filter);
        io("UseSSL", self.m_useSSL);
        io("CertificateFile", self.m_certificateFile);
        io("PrivateKeyFile", self.m_privateKeyFile);
        io("ReplaceNonLatin1DuringImport", self.m_replaceNonLatin1);
        io("DicomErrorFolderMaxSizeinGB", self.m_errorFolderMaxSizeInGB);
        io(kSources, sources);
    } else {
        io("ReplaceNonLatin1DuringImport", self.m_replaceNonLatin1);
        io("SuidGenerationAETitleFilter", filter);
        io(kSources, sources);
        io("UseSSL", self.m_useSSL);
        io("CertificateFile", self.m_certificateFile);
        io("PrivateKeyFile", self.m_privateKeyFile);
        io("DicomErrorFolderMaxSizeinGB", self.m_errorFolderMaxSizeInGB);
    }
}

CONFIGURATION_DEFINE_WRITE(SSCPConfiguration, SSCPConfiguration::WELL_KNOWN_NAME)
CONFIGURATION_DEFINE_EQUAL(SSCPConfiguration)

SSCPConfiguration::SSCPConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kDicomScp, false) {}

// The convention's read with this class's own failure text (lower-case "using", no full stop).
bool SSCPConfiguration::readVesk(const Vesk::Element& element) {
    try {
        const Vesk::Element* sources = element.getMultiElement().find(Fields::keyOf(kSources));
        if (sources != nullptr) {
            reserveForItems(*sources, ServerDicomSource::SERVER_DICOM_SOURCE, m_sources);
        }
        return Fields::readRecord(Fields::In{&element, element.getMultiElement()}, *this);
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_ERROR,
                    "SSCPConfiguration::readVesk: Failed - using partial defaults. Standard "
                    "Exception: %s\n",
                    e.what());
        return false;
    }
}

}  // namespace Configuration
