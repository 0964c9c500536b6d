/// The real service in a folder of its own, ended with the object.
#pragma once

#include <sys/types.h>

#include <string>
#include <vector>

class ServiceProcess {
 public:
  /// Returns when it listens. `data` is its folder, `arguments` come in addition.
  explicit ServiceProcess(const std::string& data, const std::vector<std::string>& arguments = {});
  ~ServiceProcess();
  ServiceProcess(const ServiceProcess&) = delete;
  ServiceProcess& operator=(const ServiceProcess&) = delete;

  const std::string& url() const { return _url; }
  std::string port() const { return _url.substr(_url.rfind(':') + 1); }
  pid_t pid() const { return _pid; }
  /// Asks it to end; its exit code.
  int stop();

 private:
  pid_t _pid = -1;
  std::string _url;
};
