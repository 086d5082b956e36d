// The aging record's outbox and its upload, against a local HTTP receiver: records go oldest
// first, byte for byte, and only a 2xx answer deletes one; a server that is down or fails
// keeps everything for the next flush; a bad endpoint never reaches the network.
#include <sys/stat.h>

#include <algorithm>
#include <filesystem>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "AgingTest/mmi_aging_upload.h"
#include "support/http_receiver.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"

namespace {

const char kDir[] = "/cache/ftx/aging/outbox";

class AgingUpload : public ::testing::Test {
  protected:
    // Keeps each record; false when one was refused.
    bool keep(const std::vector<std::string> &records) {
        for (const std::string &r : records) {
            if (mmi_aging_upload_keep(kDir, r.c_str()) != 0) return false;
        }
        return true;
    }
    // The file names in the outbox on the host, sorted.
    std::vector<std::string> files() const {
        std::vector<std::string> names;
        std::error_code ec;
        for (const auto &e : std::filesystem::directory_iterator(root.host(kDir), ec))
            names.push_back(e.path().filename().string());
        std::sort(names.begin(), names.end());
        return names;
    }
    // The bodies the receiver got, in order; every request was a JSON POST to the record path.
    std::vector<std::string> bodies() const {
        std::vector<std::string> out;
        for (const auto &r : server.requests()) {
            EXPECT_EQ("POST", r.method);
            EXPECT_EQ("/aging/record", r.path);
            EXPECT_EQ("application/json", r.contentType);
            out.push_back(r.body);
        }
        return out;
    }

    TempRoot root;
    LogCapture log;
    HttpReceiver server;
};

TEST_F(AgingUpload, KeptRecordsGoOldestFirstByteForByteAndAreThenDeleted) {
    // Quotes, escapes, UTF-8, line ends, and one long enough for a client to pause for
    // "100-continue" before its body.
    const std::vector<std::string> records = {
        R"({"cycle":1,"result":"pass"})",
        "{\"item\":\"\xe8\x80\x81\xe5\x8c\x96\",\n\t\"note\":\"a \\\"quoted\\\" \\\\ text\"}\r\n",
        "{\"log\":\"" + std::string(5000, 'x') + "\"}",
    };
    EXPECT_EQ(0, mmi_aging_upload_pending(kDir));  // no folder yet
    ASSERT_TRUE(keep(records));
    EXPECT_EQ(3, mmi_aging_upload_pending(kDir));
    const std::vector<std::string> kept = files();
    ASSERT_EQ(3u, kept.size());  // whole records only, no temporary file left
    EXPECT_EQ(records[1], root.read(std::string(kDir) + "/" + kept[1]));

    ASSERT_TRUE(server.start());
    EXPECT_EQ(3, mmi_aging_upload_flush(kDir, server.endpoint().c_str()));
    EXPECT_EQ(records, bodies());
    EXPECT_EQ(0, mmi_aging_upload_pending(kDir));
    EXPECT_TRUE(files().empty());
    const std::string url = "http://" + server.endpoint() + "/aging/record";
    EXPECT_TRUE(log.has("I AgingTest: upload: sent " + kept[0] + " to " + url + " (HTTP 200)"));
    EXPECT_TRUE(log.has("upload: sent " + kept[2] + " to " + url + " (HTTP 200)"));

    // Nothing kept: nothing sent.
    EXPECT_EQ(0, mmi_aging_upload_flush(kDir, server.endpoint().c_str()));
    EXPECT_EQ(3u, server.count());
}

TEST_F(AgingUpload, ServerDownKeepsEveryRecordUntilItListensAgain) {
    ASSERT_TRUE(server.start());
    server.stop();  // its port now refuses connections, and nothing else may take it
    HttpReceiver other;
    EXPECT_FALSE(other.start(server.port()));
    ASSERT_TRUE(keep({"{\"n\":1}", "{\"n\":2}"}));
    EXPECT_EQ(-1, mmi_aging_upload_flush(kDir, server.endpoint().c_str()));
    EXPECT_EQ(2, mmi_aging_upload_pending(kDir));
    EXPECT_TRUE(
        log.has("E AgingTest: upload: http://" + server.endpoint() + "/aging/record failed: "));
    EXPECT_TRUE(log.has(", 2 record(s) kept"));

    // Another record kept while the server is down goes after them.
    ASSERT_TRUE(keep({"{\"n\":3}"}));
    ASSERT_TRUE(server.restart());
    EXPECT_EQ(3, mmi_aging_upload_flush(kDir, server.endpoint().c_str()));
    EXPECT_EQ((std::vector<std::string>{"{\"n\":1}", "{\"n\":2}", "{\"n\":3}"}), bodies());
    EXPECT_EQ(0, mmi_aging_upload_pending(kDir));
}

TEST_F(AgingUpload, NonSuccessAnswerKeepsThatRecordAndTheRest) {
    ASSERT_TRUE(keep({"{\"n\":1}", "{\"n\":2}", "{\"n\":3}"}));
    ASSERT_TRUE(server.start());

    // The first is refused: nothing was sent, the flush stops there.
    server.set_status(500);
    EXPECT_EQ(-1, mmi_aging_upload_flush(kDir, server.endpoint().c_str()));
    EXPECT_EQ(1u, server.count());
    EXPECT_EQ(3, mmi_aging_upload_pending(kDir));
    EXPECT_TRUE(log.has("upload: http://" + server.endpoint() +
                        "/aging/record failed: HTTP 500, 3 record(s) kept"));

    // The first goes through, the second fails (a redirect is no success either): one sent.
    server.set_statuses({201, 302});
    EXPECT_EQ(1, mmi_aging_upload_flush(kDir, server.endpoint().c_str()));
    EXPECT_EQ(2, mmi_aging_upload_pending(kDir));
    EXPECT_TRUE(log.has("failed: HTTP 302, 2 record(s) kept"));

    server.set_status(200);
    EXPECT_EQ(2, mmi_aging_upload_flush(kDir, server.endpoint().c_str()));
    EXPECT_EQ(
        (std::vector<std::string>{"{\"n\":1}", "{\"n\":1}", "{\"n\":2}", "{\"n\":2}", "{\"n\":3}"}),
        bodies());
    EXPECT_EQ(0, mmi_aging_upload_pending(kDir));
}

TEST_F(AgingUpload, BadEndpointIsRefusedWithoutAConnection) {
    ASSERT_TRUE(server.start());
    ASSERT_TRUE(keep({"{}"}));
    const std::string port = std::to_string(server.port());
    const std::vector<std::string> bad = {
        "",
        "127.0.0.1",
        "127.0.0.1:",
        ":" + port,
        "127.0.0.1:0",
        "127.0.0.1:65536",
        "127.0.0.1:100000",
        "127.0.0.1:-1",
        "127.0.0.1:+" + port,
        "127.0.0.1: " + port,
        "127.0.0.1:" + port + "/",
        "127.0.0.1:" + port + "\n",
        "user@127.0.0.1:" + port,
        "127.0.0.1/x?:" + port,
        "127.0.0.1#:" + port,
        "127.0.0.1 :" + port,
        "127.0.0.1%20:" + port,
        "http://127.0.0.1:" + port,
        "::1:" + port,
        "[]:" + port,
        "[::1:" + port,
        "[::g]:" + port,
        std::string(125, 'a') + ":" + port.substr(0, 4),  // 130 bytes
    };
    for (const std::string &endpoint : bad) {
        EXPECT_EQ(-1, mmi_aging_upload_flush(kDir, endpoint.c_str())) << endpoint;
        char url[MMI_AGING_URL_SIZE] = "unchanged";
        EXPECT_EQ(-1, mmi_aging_upload_url(endpoint.c_str(), url, sizeof(url))) << endpoint;
        EXPECT_STREQ("", url) << endpoint;
    }
    EXPECT_EQ(-1, mmi_aging_upload_flush(kDir, nullptr));
    EXPECT_EQ(0u, server.count());
    EXPECT_EQ(1, mmi_aging_upload_pending(kDir));
    EXPECT_TRUE(log.has("E AgingTest: upload: endpoint \"127.0.0.1:0\" refused: port outside"));
    EXPECT_TRUE(log.has("upload: endpoint \"127.0.0.1:" + port + "?\" refused: bad port"));
}

TEST_F(AgingUpload, GoodEndpointsMakeTheRecordUrl) {
    struct Case {
        std::string endpoint, url;
    };
    const std::string longest = std::string(122, 'h') + ":65535";  // 128 bytes
    for (const Case &c : std::vector<Case>{
             {"127.0.0.1:1", "http://127.0.0.1:1/aging/record"},
             {"results-3.factory.lan:65535", "http://results-3.factory.lan:65535/aging/record"},
             {"[fe80::1:2]:8080", "http://[fe80::1:2]:8080/aging/record"},
             {"server:00080", "http://server:80/aging/record"},
             {longest, "http://" + longest + "/aging/record"},
         }) {
        char url[MMI_AGING_URL_SIZE];
        EXPECT_EQ(0, mmi_aging_upload_url(c.endpoint.c_str(), url, sizeof(url))) << c.endpoint;
        EXPECT_EQ(c.url, url);
    }
    // An output too small is refused, never cut short.
    char small[20] = "unchanged";
    EXPECT_EQ(-1, mmi_aging_upload_url("127.0.0.1:8080", small, sizeof(small)));
    EXPECT_STREQ("", small);
}

TEST_F(AgingUpload, NewRecordsSortAfterKeptOnesWhateverTheClock) {
    // A record kept before a reboot with the clock far ahead, and a temporary file a power
    // cut left half written (that record was never kept).
    root.write(std::string(kDir) + "/record_0000000041_9999999999999.json", "{\"old\":1}");
    root.write(std::string(kDir) + "/record_0000000042_9999999999999.json.tmp", "{\"half");
    ASSERT_TRUE(keep({"{\"new\":1}"}));
    const std::vector<std::string> kept = files();
    ASSERT_EQ(2u, kept.size());
    EXPECT_EQ("record_0000000041_9999999999999.json", kept[0]);
    EXPECT_EQ(0u, kept[1].rfind("record_0000000042_", 0)) << kept[1];

    ASSERT_TRUE(server.start());
    EXPECT_EQ(2, mmi_aging_upload_flush(kDir, server.endpoint().c_str()));
    EXPECT_EQ((std::vector<std::string>{"{\"old\":1}", "{\"new\":1}"}), bodies());
}

TEST_F(AgingUpload, KeepRefusesWhatItCannotStore) {
    root.write("/cache/ftx/aging/file", "not a folder");
    EXPECT_EQ(-1, mmi_aging_upload_keep("/cache/ftx/aging/file", "{}"));
    EXPECT_EQ(-1, mmi_aging_upload_keep("/cache/ftx/aging/file/outbox", "{}"));
    EXPECT_EQ(-1, mmi_aging_upload_keep(kDir, nullptr));
    EXPECT_EQ(-1, mmi_aging_upload_keep(nullptr, "{}"));
    EXPECT_EQ(-1, mmi_aging_upload_pending(nullptr));
    EXPECT_EQ(0, mmi_aging_upload_pending(kDir));
}

}  // namespace
