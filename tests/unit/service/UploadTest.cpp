#include <sys/resource.h>

#include <filesystem>

#include "ServiceFixture.h"

namespace {

const std::vector<TestFile> kText = {{"a.txt", "text/plain", "0123456789"}};

class Upload : public ServiceTest {
 protected:
  HttpAnswer put(const TestShare& share, const std::string& index, const std::string& content,
                 const std::string& caller = kAnna) {
    return http("PUT", url() + "/v1/shares/" + share.id + "/files/" + index, content, as(caller));
  }
  HttpAnswer post(const std::string& body) {
    return http("POST", url() + "/v1/shares", body, as(kAnna));
  }
};

TEST_F(Upload, NeedsAKey) {
  EXPECT_EQ(http("POST", url() + "/v1/shares", "{}").status, 401U);
  EXPECT_EQ(http("POST", url() + "/v1/shares", "{}", {{"Authorization", "Bearer x"}}).status, 401U);
  EXPECT_EQ(http("PUT", url() + "/v1/shares/1/files/0", "x").status, 401U);
}

TEST_F(Upload, IsTheSendersAlone) {
  const TestShare draft = announce(kText);
  EXPECT_EQ(put(draft, "0", kText[0].content, kBen).status, 403U);
}

TEST_F(Upload, TakesOnlyAnnouncedFiles) {
  const TestShare draft = announce(kText);
  for (const char* index : {"1", "x", "-1", "00"}) {
    EXPECT_EQ(put(draft, index, "x").status, 404U) << index;
  }
}

TEST_F(Upload, LongerThanAnnouncedIsRefused) {
  const TestShare draft = announce(kText);
  EXPECT_EQ(put(draft, "0", "01234567890").status, 413U);
  EXPECT_EQ(complete(draft).status, 409U);
}

TEST_F(Upload, ShorterThanAnnouncedIsRefused) {
  const TestShare draft = announce(kText);
  EXPECT_EQ(put(draft, "0", "012345678").status, 400U);
  EXPECT_EQ(complete(draft).status, 409U);
}

TEST_F(Upload, MayBeRepeatedUntilTheShareIsComplete) {
  const TestShare draft = announce(kText);
  EXPECT_EQ(put(draft, "0", "xxxxxxxxxx").status, 204U);
  EXPECT_EQ(put(draft, "0", kText[0].content).status, 204U);
  EXPECT_EQ(complete(draft).status, 200U);
  EXPECT_EQ(httpGet(address(draft, "file/0")).body, kText[0].content);
  EXPECT_EQ(put(draft, "0", "yyyyyyyyyy").status, 409U);
  EXPECT_EQ(httpGet(address(draft, "file/0")).body, kText[0].content);
}

TEST_F(Upload, KeepsOddNamesButNeverAsPaths) {
  const std::vector<TestFile> odd = {{"../../escape", "text/plain", "1"},
                                     {"/etc/passwd", "text/plain", "2"},
                                     {"a\nb\x01%s", "text/plain", "3"},
                                     {"\xe2\x80\xaegpj.exe", "text/plain", "4"}};
  const TestShare shared = share(odd);
  const Json manifest = parseJson(httpGet(address(shared, "manifest.json")).body);
  JsonArray* files = json_object_get_array_member(json_node_get_object(manifest.get()), "files");
  ASSERT_EQ(json_array_get_length(files), odd.size());
  for (guint i = 0; i < odd.size(); i++) {
    EXPECT_EQ(json_object_get_string_member(json_array_get_object_element(files, i), "name"),
              odd[i].name);
    EXPECT_TRUE(
        std::filesystem::exists(data("share/" + shared.token + "/file/" + std::to_string(i))));
  }
  for (const auto& entry : std::filesystem::recursive_directory_iterator(data())) {
    EXPECT_EQ(entry.path().filename().string().find("escape"), std::string::npos);
  }
}

TEST_F(Upload, RefusesAnnouncementsThatMakeNoSense) {
  const char* const to = R"("to":["+821012345678"])";
  const std::string file = R"({"name":"a","size":1,"type":"text/plain"})";
  const std::string files = "\"files\":[" + file + "]";
  for (const std::string& body : std::vector<std::string>{
           "",
           "x",
           "[]",
           "{}",
           "{" + std::string(to) + "}",
           "{" + files + "}",
           R"({"to":[],)" + files + "}",
           R"({"to":["0"],)" + files + "}",
           R"({"to":["+8210 1234"],)" + files + "}",
           R"({"to":[1],)" + files + "}",
           std::string("{") + to + R"(,"files":[]})",
           std::string("{") + to + R"(,"files":[1]})",
           std::string("{") + to + R"(,"files":[{"name":"a","size":1}]})",
           std::string("{") + to + R"(,"files":[{"name":"","size":1,"type":"t"}]})",
           std::string("{") + to + R"(,"files":[{"name":"a","size":-1,"type":"t"}]})",
           std::string("{") + to + R"(,"files":[{"name":"a","size":4294967296,"type":"t"}]})",
           std::string("{") + to + R"(,"expires_in_s":0,)" + files + "}",
           std::string("{}{") + to + "," + files + "}",
           std::string("{") + to + R"(,"expires_in_s":99999999999,)" + files + "}",
           "{\"to\":[\"+821012345678\"],\"files\":[{\"name\":\"\xff\xfe\",\"size\":1,\"type\":"
           "\"t\"}]}",
       }) {
    EXPECT_EQ(post(body).status, 400U) << body;
  }
}

TEST_F(Upload, SurvivesAMegabyteOfBrackets) {
  EXPECT_EQ(post(std::string(1 << 20, '[')).status, 400U);
  EXPECT_EQ(post("{\"a\":" + std::string(1 << 20, '[')).status, 400U);
  EXPECT_EQ(post("{\"a\":/*\"*/" + std::string(1 << 20, '[')).status, 400U);
  EXPECT_EQ(post("{\"a\":'\"',\"b\":" + std::string(1 << 20, '[')).status, 400U);
  EXPECT_EQ(httpGet(url() + "/v1/stats").status, 200U);
}

TEST_F(Upload, RefusesAnAnnouncementOfManyMegabytes) {
  EXPECT_EQ(post(std::string(3 << 20, ' ')).status, 413U);
}

TEST_F(Upload, RefusesALenientShareUnlessItIsThereForTests) {
  const char* const share = R"({"to":["+821012345678"],"lenient":true,"files":[{}]})";
  EXPECT_EQ(post(share).status, 400U);
  start({"--lenient"});
  EXPECT_EQ(post(share).status, 201U);
}

TEST_F(Upload, LeavesGapsOnlyInALenientShare) {
  start({"--lenient"});
  const HttpAnswer odd = post(
      R"({"to":["+821012345678"],"lenient":true,"files":[{"name":"a"},{"size":5},{},
          {"name":"b","size":1,"type":"image/png","thumb":"http://x/\"../y"}]})");
  ASSERT_EQ(odd.status, 201U) << odd.body;
  const TestShare draft = {std::to_string(odd.number("request_id")), odd.text("token")};
  ASSERT_EQ(complete(draft).status, 200U);
  const std::string manifest = httpGet(address(draft, "manifest.json")).body;
  EXPECT_NE(manifest.find(R"({"name":"a","url":"file/0"},{"size":5,"url":"file/1"})"),
            std::string::npos)
      << manifest;
  EXPECT_NE(manifest.find(R"(http://x/\"../y)"), std::string::npos) << manifest;
}

TEST_F(Upload, TakesAShareOfTenThousandFilesAndNoMore) {
  std::string list;
  for (int i = 0; i < 10000; i++) list += list.empty() ? "{}" : ",{}";
  const std::string head = R"({"to":["+821012345678"],"lenient":true,"files":[)";
  start({"--lenient"});
  const HttpAnswer largest = post(head + list + "]}");
  EXPECT_EQ(largest.status, 201U);
  EXPECT_EQ(complete({std::to_string(largest.number("request_id")), ""}).status, 200U);
  EXPECT_EQ(post(head + list + ",{}]}").status, 400U);
}

TEST_F(Upload, IsRefusedWhileSharingIsSwitchedOff) {
  const std::string status = url() + "/v1/subscribers/" + kAnna + "/services/2";
  EXPECT_EQ(httpGet(status, as(kAnna)).text("status"), "on");
  EXPECT_EQ(http("PUT", status, R"({"status":"off"})", as(kAnna)).text("status"), "off");
  EXPECT_EQ(post(R"({"to":["+821012345678"],"files":[{"name":"a","size":1,"type":"t"}]})").status,
            403U);
  EXPECT_EQ(http("PUT", status, R"({"status":"maybe"})", as(kAnna)).status, 400U);
  EXPECT_EQ(http("PUT", status, R"({"status":"on"})", as(kAnna)).text("status"), "on");
  EXPECT_EQ(httpGet(status, as(kBen)).status, 403U);
}

// Anybody can send a body, and its sender goes on sending however early the answer is clear.
TEST_F(Upload, KeepsNothingOfABodyThatItRefuses) {
#ifdef __SANITIZE_ADDRESS__
  GTEST_SKIP() << "the sanitizer's own memory would count";
#endif
  const rlimit bound{96 << 20, 96 << 20};
  ASSERT_EQ(prlimit(service().pid(), RLIMIT_DATA, &bound, nullptr), 0);
  const std::string body(200 << 20, ' ');
  EXPECT_EQ(http("POST", url() + "/v1/subscribers", body).status, 413U);
  EXPECT_EQ(http("PUT", url() + "/v1/shares/1/files/0", body).status, 401U);
  EXPECT_EQ(httpGet(url() + "/v1/stats").status, 200U);
}

// Neither way may hold the file in memory; mapped files do not count as data.
TEST_F(Upload, AndDownloadOf200MegabytesNeedLittleMemory) {
#ifdef __SANITIZE_ADDRESS__
  GTEST_SKIP() << "the sanitizer's own memory would count";
#endif
  const rlimit bound{96 << 20, 96 << 20};
  ASSERT_EQ(prlimit(service().pid(), RLIMIT_DATA, &bound, nullptr), 0);
  const TempFolder folder;
  const std::string file = folder.write("large", "");
  constexpr long long size = 200 << 20;
  std::filesystem::resize_file(file, size);

  const HttpAnswer announced =
      post(R"({"to":["+821012345678"],"files":[{"name":"a","size":209715200,"type":"t"}]})");
  const TestShare draft = {std::to_string(announced.number("request_id")), announced.text("token")};
  EXPECT_EQ(httpSend(url() + "/v1/shares/" + draft.id + "/files/0", file, as(kAnna)).status, 204U);
  ASSERT_EQ(complete(draft).status, 200U);
  EXPECT_EQ(httpCount(address(draft, "file/0")), size);
}

TEST_F(Upload, ThatBreaksOffLeavesNothing) {
  const TestShare draft = announce({{"a", "text/plain", std::string(1 << 20, 'x')}});
  GSocketClient* client = g_socket_client_new();
  GSocketConnection* connection = g_socket_client_connect_to_host(
      client, "127.0.0.1", static_cast<guint16>(std::stoi(service().port())), nullptr, nullptr);
  ASSERT_NE(connection, nullptr);
  const std::string half = "PUT /v1/shares/" + draft.id + "/files/0 HTTP/1.1\r\nHost: x\r\n" +
                           "Authorization: " + as(kAnna)[0].second +
                           "\r\nContent-Length: 1048576\r\n\r\n" + std::string(1000, 'x');
  g_output_stream_write_all(g_io_stream_get_output_stream(G_IO_STREAM(connection)), half.data(),
                            half.size(), nullptr, nullptr, nullptr);
  const auto incoming = [this] { return !std::filesystem::is_empty(data("incoming")); };
  EXPECT_TRUE(eventually(incoming));
  g_object_unref(connection);
  g_object_unref(client);
  EXPECT_TRUE(eventually([&] { return !incoming(); }));
  EXPECT_EQ(complete(draft).status, 409U);
}

}  // namespace
