#include "ServiceFixture.h"

#include <chrono>
#include <thread>

namespace {

std::string announcement(const std::vector<TestFile>& files, long long lifetimeS) {
  JsonBuilder* json = json_builder_new();
  const auto text = [json](const char* name, const std::string& value) {
    json_builder_set_member_name(json, name);
    json_builder_add_string_value(json, value.c_str());
  };
  const auto number = [json](const char* name, long long value) {
    json_builder_set_member_name(json, name);
    json_builder_add_int_value(json, value);
  };
  json_builder_begin_object(json);
  number("expires_in_s", lifetimeS);
  json_builder_set_member_name(json, "to");
  json_builder_begin_array(json);
  json_builder_add_string_value(json, kBen.c_str());
  json_builder_end_array(json);
  json_builder_set_member_name(json, "files");
  json_builder_begin_array(json);
  for (const TestFile& file : files) {
    json_builder_begin_object(json);
    text("name", file.name);
    text("type", file.type);
    number("size", static_cast<long long>(file.content.size()));
    json_builder_end_object(json);
  }
  json_builder_end_array(json);
  json_builder_end_object(json);
  JsonNode* root = json_builder_get_root(json);
  char* written = json_to_string(root, FALSE);
  const std::string result = written;
  g_free(written);
  json_node_unref(root);
  g_object_unref(json);
  return result;
}

}  // namespace

void ServiceTest::start(const std::vector<std::string>& arguments) {
  _service.reset();
  _service = std::make_unique<ServiceProcess>(data(), arguments);
  ASSERT_NE(_service->url(), "");
}

std::string ServiceTest::data(const std::string& name) const {
  return _folder.path("data") + (name.empty() ? "" : "/" + name);
}

HttpHeaders ServiceTest::as(const std::string& msisdn) {
  std::string& key = _keys[msisdn];
  if (key.empty()) {
    key = http("POST", url() + "/v1/subscribers", "{\"msisdn\":\"" + msisdn + "\"}").text("key");
  }
  return {{"Authorization", "Bearer " + key}};
}

TestShare ServiceTest::announce(const std::vector<TestFile>& files, long long lifetimeS) {
  const HttpAnswer answer =
      http("POST", url() + "/v1/shares", announcement(files, lifetimeS), as(kAnna));
  EXPECT_EQ(answer.status, 201U) << answer.body;
  return {std::to_string(answer.number("request_id")), answer.text("token")};
}

void ServiceTest::upload(const TestShare& share, const std::vector<TestFile>& files) {
  for (std::size_t i = 0; i < files.size(); i++) {
    const HttpAnswer answer =
        http("PUT", url() + "/v1/shares/" + share.id + "/files/" + std::to_string(i),
             files[i].content, as(kAnna));
    EXPECT_EQ(answer.status, 204U) << answer.body;
  }
}

HttpAnswer ServiceTest::complete(const TestShare& share) {
  return http("POST", url() + "/v1/shares/" + share.id + "/complete", {}, as(kAnna));
}

TestShare ServiceTest::share(const std::vector<TestFile>& files, long long lifetimeS) {
  const TestShare share = announce(files, lifetimeS);
  upload(share, files);
  EXPECT_EQ(complete(share).status, 200U);
  return share;
}

HttpAnswer ServiceTest::recall(const TestShare& share, const std::string& caller) {
  return http("POST", url() + "/v1/shares/" + share.id + "/recall", {}, as(caller));
}

std::string ServiceTest::address(const TestShare& share, const std::string& path) const {
  return url() + "/share/" + share.token + "/" + path;
}

HttpAnswer ServiceTest::poll(const std::string& msisdn, long long after, int wait) {
  const std::string number = "%2B" + msisdn.substr(1);
  return httpGet(url() + "/v1/push?msisdn=" + number + "&after=" + std::to_string(after) +
                     "&wait=" + std::to_string(wait),
                 as(msisdn));
}

bool eventually(const std::function<bool()>& condition) {
  const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(20);
  while (!condition()) {
    if (std::chrono::steady_clock::now() > end) return false;
    std::this_thread::sleep_for(std::chrono::milliseconds(10));
  }
  return true;
}
