// The sample documents of examples/dicom: every UID they hold is one of the DICOM standard's (the
// UID table Debian ships with its DICOM toolkit headers, or tests/data/dicom/StandardUids.txt
// made from it when the headers are not installed), of the right kind; and they read completely
// into what they mean.
#include <gtest/gtest.h>

#include <fstream>
#include <map>
#include <string>

#include "Configuration/DicomClientConfiguration.h"
#include "Configuration/SOPServiceConfiguration.h"
#include "DicomTestSupport.h"

namespace Configuration {
namespace {

const char kInstalledTable[] = "/usr/include/dcmtk/dcmdata/dcuid.h";

// Adds the UID of a line "#define UID_<name> "<uid>"" (a literal UID only) to uids.
void addDefinedUid(const std::string& line, std::map<std::string, std::string>& uids) {
    const std::string prefix = "#define UID_";
    if (line.compare(0, prefix.size(), prefix) != 0) {
        return;
    }
    const std::size_t nameEnd = line.find_first_of(" \t", prefix.size());
    const std::size_t open = line.find_first_not_of(" \t", nameEnd);
    if (nameEnd == std::string::npos || open == std::string::npos || line[open] != '"') {
        return;
    }
    const std::size_t close = line.find('"', open + 1);
    const std::string uid = line.substr(open + 1, close - open - 1);
    if (close != std::string::npos && !uid.empty() &&
        uid.find_first_not_of("0123456789.") == std::string::npos) {
        uids[uid] = line.substr(prefix.size(), nameEnd - prefix.size());
    }
}

// UID to its name in the standard's table.
const std::map<std::string, std::string>& standardUids() {
    static const std::map<std::string, std::string> table = [] {
        std::map<std::string, std::string> uids;
        std::ifstream installed(kInstalledTable);
        if (installed) {
            for (std::string line; std::getline(installed, line);) {
                addDefinedUid(line, uids);
            }
            return uids;
        }
        std::ifstream committed(std::string(QUORVEX_TEST_DATA) + "/dicom/StandardUids.txt");
        std::string name;
        std::string uid;
        while (committed >> name >> uid) {
            uids[uid] = name;
        }
        return uids;
    }();
    return table;
}

// The UID is in the table, and its name there says kind ("TransferSyntax", "Storage").
void expectStandard(const ACE_CString& uid, const std::string& kind, const char* where) {
    const auto found = standardUids().find(uid.c_str());
    ASSERT_NE(found, standardUids().end()) << where << ": " << uid.c_str();
    EXPECT_NE(found->second.find(kind), std::string::npos)
        << where << ": " << uid.c_str() << " is " << found->second;
}

template <class T>
T readExample(const char* file) {
    const Vesk::Element tree = Testing::parsed(
        Testing::fileText(std::string(QUORVEX_TEST_DATA) + "/../../examples/dicom/" + file));
    T document;
    EXPECT_TRUE(document.readVesk(tree)) << file;
    return document;
}

TEST(DicomSamples, EveryUidIsTheStandardsOwn) {
    ASSERT_GT(standardUids().size(), 400u);
    const auto config = readExample<SOPServiceConfiguration>("SOPServiceConfiguration.xml");
    for (const auto& row : config.getSupportedTransferSyntaxList().getSupportedTransferSyntaxes()) {
        expectStandard(row.getUID(), "TransferSyntax", row.getName().c_str());
    }
    for (const SOPService& service : config.getSOPServiceList().getSOPServices()) {
        expectStandard(service.getUID(), "Storage", service.getName().c_str());
    }
    for (const FilterTag& tag : config.getFilterTagList().getFilterTags()) {
        if (tag.getSOPClassUID().length() > 0) {
            expectStandard(tag.getSOPClassUID(), "Storage", tag.getTag().c_str());
        }
    }
    const auto client = readExample<DicomClientConfiguration>("DicomClient.xml");
    for (const auto& entry : client.getViewableSopClasses()) {
        expectStandard(entry.first, "Storage", entry.second.getName().c_str());
    }
}

TEST(DicomSamples, TheServiceDocumentReadsToWhatItMeans) {
    const auto config = readExample<SOPServiceConfiguration>("SOPServiceConfiguration.xml");
    EXPECT_GE(config.getSupportedTransferSyntaxList().getSupportedTransferSyntaxes().size(), 20u);
    const auto& services = config.getSOPServiceList().getSOPServices();
    ASSERT_GE(services.size(), 60u);
    std::map<std::string, std::string> byName;
    for (const SOPService& service : services) {
        byName[service.getName().c_str()] = Testing::describe(service);
    }
    const struct {
        const char* name;
        const char* resolved;
    } kExpected[] = {
        {"CT Image Storage",
         "type=IMAGE enabled=1 template=AllCompressed: 1+ 2+ 3+ 4+ 5+ 6+ 7+ 8+ 9+ 10+ 11+ 12+ "
         "13+ 14+ 15+ 16+ 17+"},
        {"Digital Mammography X-Ray Image Storage - For Presentation",
         "type=IMAGE enabled=1 template=Lossless: 1+ 2+ 3+ 4+ 7+ 8+ 9+ 11+ 13+ 17+"},
        {"RT Plan Storage", "type=IMAGE enabled=1 template=: 1+ 2+ 4+"},
        {"Raw Data Storage", "type=PRIVATE enabled=1 template=: 1+ 2+ 3+"},
        {"Video Photographic Image Storage",
         "type=IMAGE enabled=1 template=Video: 1- 2+ 18+ 19- 20+ 21- 22- 23- 24- 25- 26-"},
        {"Grayscale Softcopy Presentation State Storage",
         "type=GSPS enabled=1 template=Uncompressed: 2+ 1+"},
        {"Blending Softcopy Presentation State Storage",
         "type=CSPS enabled=1 template=Lossless: 2- 1- 9- 11-"},
        {"Pseudo-Color Softcopy Presentation State Storage",
         "type=CSPS enabled=0 template=Uncompressed: 2+ 1+"},
        {"Encapsulated PDF Storage", "type=IMAGE enabled=1 template=Documents: 1+ 2+ 4+"},
        {"Key Object Selection Document Storage", "type=KO enabled=1 template=Documents: 1+ 2+ 4+"},
        {"12-lead ECG Waveform Storage", "type=IMAGE enabled=0 template=: 1+ 2+"},
        {"General ECG Waveform Storage", "type=IMAGE enabled=1 template=: 1+ 2+"},
    };
    for (const auto& expected : kExpected) {
        EXPECT_EQ(byName[expected.name], expected.resolved) << expected.name;
    }
}

TEST(DicomSamples, EveryViewableClassIsAnOfferedService) {
    const auto config = readExample<SOPServiceConfiguration>("SOPServiceConfiguration.xml");
    const auto client = readExample<DicomClientConfiguration>("DicomClient.xml");
    EXPECT_GE(client.getViewableSopClasses().size(), 40u);
    std::size_t viewable = 0;
    for (const SOPService& service : config.getSOPServiceList().getSOPServices()) {
        viewable += client.IsSopClassViewable(service.getUID()) ? 1 : 0;
    }
    EXPECT_EQ(viewable, client.getViewableSopClasses().size());
}

}  // namespace
}  // namespace Configuration
