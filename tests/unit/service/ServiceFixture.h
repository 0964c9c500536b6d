/// Tests against a running service, with Anna, who sends, and Ben, who receives.
#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "Http.h"
#include "ServiceProcess.h"
#include "TempFolder.h"

inline const std::string kAnna = "+821011112222";
inline const std::string kBen = "+821012345678";

struct TestFile {
  std::string name;
  std::string type;
  std::string content;
};

struct TestShare {
  std::string id;
  std::string token;
};

class ServiceTest : public testing::Test {
 protected:
  ServiceTest() { start(); }

  /// Starts the service, or starts it anew on what it had stored.
  void start(const std::vector<std::string>& arguments = {});
  const std::string& url() const { return _service->url(); }
  ServiceProcess& service() { return *_service; }
  std::string data(const std::string& name = {}) const;

  /// Signs the number up at its first use.
  HttpHeaders as(const std::string& msisdn);
  TestShare announce(const std::vector<TestFile>& files, long long lifetimeS = 3600);
  void upload(const TestShare& share, const std::vector<TestFile>& files);
  HttpAnswer complete(const TestShare& share);
  /// All three; returns when recipients can have it.
  TestShare share(const std::vector<TestFile>& files, long long lifetimeS = 3600);
  HttpAnswer recall(const TestShare& share, const std::string& caller = kAnna);
  std::string address(const TestShare& share, const std::string& path) const;
  /// `wait` in seconds.
  HttpAnswer poll(const std::string& msisdn, long long after, int wait = 0);

 private:
  TempFolder _folder;
  std::unique_ptr<ServiceProcess> _service;
  std::map<std::string, std::string> _keys;
};

/// Tries until the condition holds; false when that takes longer than any test may.
bool eventually(const std::function<bool()>& condition);
