// configctl --output json against a real service holding the example site: each list command's
// output is parsed by a JSON parser (python3) and checked for what the site holds.
#include <gtest/gtest.h>

#include <fstream>
#include <string>

#include "ExampleSite.h"
#include "InProcessService.h"
#include "ToolRun.h"

namespace Configctl {
namespace {

using Testing::configctl;
using Testing::shell;
using Testing::ToolRun;

// One command and a Python expression over its parsed output d (and its raw text raw) that
// must be true.
struct JsonCase {
    const char* arguments;
    const char* check;
};

const JsonCase kCases[] = {
    {"hosts", R"(d == ['TestHost'])"},
    {"items --host '*'",
     R"(any(i['host'] == 'TestHost' and i['name'] == 'BrimmetServer\\DicomScp'
            and i['lastModified'] for i in d))"},
    {"users",
     R"(d == [{'id': 'alice', 'type': 'Radiologist', 'loggedIn': True, 'onCall': True,
               'name': 'Doe^Alice "Ali"'},
              {'id': 'bob', 'type': 'Technologist', 'loggedIn': False, 'onCall': False,
               'name': ''}])"},
    {"folders alice",
     R"(d['user'] == 'alice' and d['inbox']['folders'] == [] and
        d['masterFolder']['folders'][0]['name'] == 'Cases' and
        d['masterFolder']['folders'][0]['shared'] and
        d['masterFolder']['folders'][0]['items'] == 2 and
        [f['name'] for f in d['masterFolder']['folders'][0]['folders']] == ['Hard'])"},
    {"processes --host Store1",
     R"([(p['moduleType'], p['moduleTypeName'], p['selected'], p['executable'], p['singleton'],
         [(s['service'], s['enabled']) for s in p['services']])
        for p in d['processes'] if p['process'] == 'QuorvexExportServer'][0][:5] ==
        (2, 'export server', True,
         'C:\\Program Files\\Quorvex\\Storage\\bin\\QuorvexExportServer.exe', True) and
        [[(s['service'], s['enabled']) for s in p['services']][:3] for p in d['processes']
         if p['process'] == 'QuorvexExportServer'] ==
        [[('Object Request Broker', True), ('KelExport Service', True),
          ('Qrscp KelExport Service', False)]] and
        d['documentModuleType'] == 1 and d['valid'] and d['invalidReason'] is None)"},
    {"services QuorvexArchiveServer --host Store1",
     R"(len(d) == 1 and d[0]['directive'] == 'dynamic TapeArchiveService Service_Object * '
        'QuorvexTapeArchive:_make_TapeArchiveService() "-Library TSM1"')"},
    {"dicom-nodes",
     R"(len(d) == 12 and d[0] == {'document': 'KelExportRemoteConfigurations',
        'role': 'export destination', 'aeTitle': 'LTA_NORTH',
        'host': 'lta01.dc-b.northmed.example', 'port': '11112', 'name': 'Long-term archive'}
        and d[-1]['host'] is None and d[-1]['port'] is None and d[-1]['aeTitle'] == 'STMARY_PACS')"},
    {"check",
     R"(d['problems'] == [] and
        [x['complete'] for x in d['documents'] if x['path'].endswith('Qrscp')] == [True])"},
    {"sop",
     R"(len(d['services']) == 69 and sum(s['offered'] for s in d['services']) == 66 and
        [(len(s['transferSyntaxes']), sum(t['enabled'] for t in s['transferSyntaxes']),
          s['template'], s['objectType']) for s in d['services']
         if s['name'] == 'Video Photographic Image Storage'] == [(11, 3, 'Video', 'IMAGE')] and
        [s['template'] for s in d['services'] if s['name'] == 'RT Plan Storage'] == [None])"},
    {"topology",
     R"(d['locations'][0] == {'name': 'Main Hospital', 'type': 'main', 'wan': False,
        'servers': ['qvx-main-01', 'qvx-main-02'], 'chain': '[__PERSISTENT__]->[__MIRROR__]',
        'resolved': '[9B2E7C14-5D3A-4E8F-A1B6-2C7D8E9F0A1B]->'
                    '[D1E2F3A4-B5C6-4D7E-8F90-A1B2C3D4E5F6]'} and
        {'name': 'tsm-b.archive.hospital.example', 'port': 1500} in d['tapeServers'])"},
    {"archive",
     R"('change-me' not in raw and d['tapeServers'] and
        all(s['password'] == '********' for s in d['tapeServers']) and
        any(s['user'] == 'qvx_archive' for s in d['tapeServers']))"},
};

class JsonOutput : public ::testing::Test {
protected:
    JsonOutput() {
        const std::string site = std::string(QUORVEX_EXAMPLES) + "/site/";
        for (const char* name : Testing::kDicomSiteDocuments) {
            put(std::string("'BrimmetServer\\") + name + "' " + site + name + ".xml");
        }
        for (const char* name : Testing::kStorageSiteDocuments) {
            put(std::string("'BrimmetServer\\") + name + "' " + site + name + ".xml");
        }
        put("--host Store1 'BrimmetServer\\ProcessesAndServices' " + site +
            "ProcessesAndServices.StorageServer.xml");
        put("'BrimmetServer\\SOPServiceConfiguration' " + std::string(QUORVEX_EXAMPLES) +
            "/dicom/SOPServiceConfiguration.xml");
        EXPECT_EQ(configctl(server + " register QuorvexStorageServer").status, 0);
        Testing::addSampleUsers(service.server().workflow());
    }
    void put(const std::string& arguments) {
        const ToolRun run = configctl(server + " put " + arguments);
        EXPECT_EQ(run.status, 0) << arguments << ": " << run.out;
    }
    // Whether python3 parses text as JSON with check true of it.
    ToolRun parse(const std::string& text, const std::string& check) {
        const std::string base = service.storeDirectory() + "-json";
        std::ofstream(base + ".out", std::ios::binary) << text;
        std::ofstream(base + ".py")
            << "import json, sys\nraw = open(sys.argv[1]).read()\n"
            << "d = json.loads(raw)\nsys.exit(0 if (" << check << ") else 1)\n";
        return shell("python3 " + base + ".py " + base + ".out");
    }

    ServiceTesting::InProcessService service;
    const std::string server = "--server " + service.address();
};

TEST_F(JsonOutput, EveryListCommandPrintsOneParsableValue) {
    for (const JsonCase& c : kCases) {
        const ToolRun run = configctl(server + " --output json " + c.arguments);
        ASSERT_EQ(run.status, 0) << c.arguments << ": " << run.out;
        EXPECT_EQ(run.out.find('\n'), run.out.size() - 1) << c.arguments << ": " << run.out;
        const ToolRun parsed = parse(run.out, c.check);
        EXPECT_EQ(parsed.status, 0) << c.arguments << ": " << parsed.out << "\n" << run.out;
    }
}

// A command that prints one document, not a list, refuses json rather than print text.
TEST_F(JsonOutput, OtherCommandsRefuseJson) {
    for (const char* arguments : {"get 'BrimmetServer\\DicomScp'", "whoami", "topology --dot"}) {
        const ToolRun run = configctl(server + " --output json " + arguments);
        EXPECT_EQ(run.status, 6) << arguments << ": " << run.out;
    }
}

}  // namespace
}  // namespace Configctl
