// configctl's DICOM commands against a real service holding the example site: the remote-node
// table, a check that finds nothing in the good site, and one that finds every mistake planted
// in a broken copy of it (exit status 2, one line per mistake).
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdio>
#include <fstream>
#include <map>
#include <sstream>
#include <string>

#include "ExampleSite.h"
#include "InProcessService.h"
#include "ToolRun.h"

namespace Configctl {
namespace {

using Testing::configctl;
using Testing::ToolRun;

std::string siteFile(const std::string& name) {
    std::ifstream in(std::string(QUORVEX_EXAMPLES) + "/site/" + name + ".xml", std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

// (document, text to replace, replacement): the planted mistakes and what check says about each.
struct Planted {
    const char* document;
    const char* from;
    const char* to;
    const char* reported;
};

const Planted kPlanted[] = {
    {"KelExportRemoteConfigurations",
     "<s>LTA_NORTH</s></e>\n                <e "
     "k=\"HostName\"><s>lta01.dc-b.northmed.example</s></e>\n                <e "
     "k=\"Port\"><s>11112</s></e>\n              </l>\n            </e>\n            <e "
     "k=\"MaximumNumberOfConcurrentRequests\"><s>4",
     "<s>LTA_NORTH_ARCHIVE1</s></e>\n                <e "
     "k=\"HostName\"><s>lta01.dc-b.northmed.example</s></e>\n                <e "
     "k=\"Port\"><s>11112</s></e>\n              </l>\n            </e>\n            <e "
     "k=\"MaximumNumberOfConcurrentRequests\"><s>4",
     "KelExportRemoteConfigurations: export destination \"Long-term archive\": AE title "
     "\"LTA_NORTH_ARCHIVE1\" is 18 characters long (at most 16)"},
    {"DicomScp", "<s>US_WARD3</s></e>\n            <e k=\"Modality\">",
     "<s>US\\WARD3</s></e>\n            <e k=\"Modality\">",
     "DicomScp: known source \"Ultrasound, ward 3\": AE title \"US\\WARD3\" holds the character "
     "0x5C, which DICOM does not allow in an AE title"},
    {"KelExportRemoteConfigurations", "<s>2762</s>", "<s>70000</s>",
     "KelExportRemoteConfigurations: export destination \"Teleradiology partner\": port \"70000\" "
     "is outside 1-65535"},
    {"KelQuery", "<s>pacs.stmary.example</s>", "<s>pacs2.stmary.example</s>",
     "StorageCommit: commitment requester \"St. Mary referral PACS\": AE title \"STMARY_PACS\" is "
     "at pacs.stmary.example:104, but query archive \"St. Mary referral PACS\" has it at "
     "pacs2.stmary.example:104"},
    {"AutoExport", "<s>Teleradiology partner</s>", "<s>Teleradiology partner (old)</s>",
     "AutoExport: rule \"Emergency CT to teleradiology\" sends to \"Teleradiology partner (old)\", "
     "which no export destination in KelExportRemoteConfigurations defines"},
    {"KelExportRemoteConfigurations",
     "<e k=\"LongTermStorageDestination\"><s>Long-term archive</s>",
     "<e k=\"LongTermStorageDestination\"><s>Long term archive</s>",
     "KelExportRemoteConfigurations: the long-term storage destination \"Long term archive\" is "
     "not one of its export destinations"},
    {"Qrscp", "<e k=\"MaxDatabaseResults\"><s>2000</s></e>", "", "Qrscp: does not read completely"},
};

class DicomSiteCommands : public ::testing::Test {
protected:
    // Stores every document of the example site, with edits applied, through configctl put.
    void storeSite(const std::map<std::string, std::string>& documents) {
        for (const auto& [name, xml] : documents) {
            const std::string file = service.storeDirectory() + "-" + name + ".xml";
            std::ofstream(file, std::ios::binary) << xml;
            const ToolRun put = configctl(server() + " put 'BrimmetServer\\" + name + "' " + file);
            ASSERT_EQ(put.status, 0) << name << ": " << put.out;
        }
    }
    std::map<std::string, std::string> goodSite() const {
        std::map<std::string, std::string> documents;
        for (const char* name : Testing::kDicomSiteDocuments) {
            documents[name] = siteFile(name);
        }
        return documents;
    }
    std::string server() const { return "--server " + service.address(); }

    ServiceTesting::InProcessService service;
};

TEST_F(DicomSiteCommands, NodesListEveryRemoteNodeOfTheSite) {
    storeSite(goodSite());
    const ToolRun nodes = configctl(server() + " dicom-nodes");
    ASSERT_EQ(nodes.status, 0) << nodes.out;
    const char* const kTable =
        "DOCUMENT                       ROLE                  AE TITLE     HOST                    "
        "          PORT   NAME\n"
        "KelExportRemoteConfigurations  export destination    LTA_NORTH    "
        "lta01.dc-b.northmed.example       11112  Long-term archive\n"
        "KelExportRemoteConfigurations  export commitment     LTA_NORTH    "
        "lta01.dc-b.northmed.example       11112  Long-term archive commitment\n"
        "KelExportRemoteConfigurations  export destination    TELERAD_NL   "
        "dicom.telerad-partner.example     2762   Teleradiology partner\n"
        "KelExportRemoteConfigurations  export destination    RHX_GATEWAY  gateway.rhx.example     "
        "          11112  Regional health exchange (web service)\n"
        "KelQuery                       query archive         LTA_NORTH    "
        "lta01.dc-b.northmed.example       11112  Long-term archive\n"
        "KelQuery                       query archive         STMARY_PACS  pacs.stmary.example     "
        "          104    St. Mary referral PACS\n"
        "StorageCommit                  commitment requester  CT_ED1       "
        "ct-ed1.modality.northmed.example  4006   CT scanner, emergency department\n"
        "StorageCommit                  commitment requester  STMARY_PACS  pacs.stmary.example     "
        "          104    St. Mary referral PACS\n"
        "DicomScp                       known source          CT_ED1       -                       "
        "          -      CT scanner, emergency department\n"
        "DicomScp                       known source          MR_NEURO3T   -                       "
        "          -      MR 3T, neuro suite\n"
        "DicomScp                       known source          US_WARD3     -                       "
        "          -      Ultrasound, ward 3\n"
        "DicomScp                       known source          STMARY_PACS  -                       "
        "          -      St. Mary referral PACS\n";
    EXPECT_EQ(kTable, nodes.out);
}

TEST_F(DicomSiteCommands, CheckFindsNothingInTheGoodSite) {
    storeSite(goodSite());
    const ToolRun check = configctl(server() + " check");
    EXPECT_EQ(check.status, 0) << check.out;
    EXPECT_NE(check.out.find("  BrimmetServer\\KelQuery: read completely\n"), std::string::npos);
    EXPECT_NE(check.out.find("  BrimmetServer\\KelExportLocal: read completely\n"),
              std::string::npos);
    EXPECT_NE(check.out.find("  BrimmetServer\\DicomClient: not stored (the defaults apply)\n"),
              std::string::npos);
    EXPECT_NE(check.out.find("\n0 mistakes found\n"), std::string::npos) << check.out;
}

TEST_F(DicomSiteCommands, CheckFindsEveryPlantedMistake) {
    std::map<std::string, std::string> documents = goodSite();
    for (const Planted& planted : kPlanted) {
        std::string& xml = documents[planted.document];
        const auto at = xml.find(planted.from);
        ASSERT_NE(at, std::string::npos) << planted.from;
        xml.replace(at, std::string(planted.from).size(), planted.to);
    }
    storeSite(documents);
    const ToolRun check = configctl(server() + " check");
    EXPECT_EQ(check.status, 2) << check.out;
    for (const Planted& planted : kPlanted) {
        EXPECT_NE(check.out.find(std::string("  ") + planted.reported), std::string::npos)
            << planted.reported << "\n--- in ---\n"
            << check.out;
    }
    const std::string count = "\n" + std::to_string(std::size(kPlanted)) + " mistakes found\n";
    EXPECT_NE(check.out.find(count), std::string::npos) << check.out;
    EXPECT_NE(check.out.find("configctl: 7 mistakes in the DICOM documents"), std::string::npos);
}

}  // namespace
}  // namespace Configctl
