#include "Process.h"

#include <gio/gio.h>
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <memory>

namespace phone {
namespace {

struct FreeError {
  void operator()(GError* error) const { g_error_free(error); }
};

char** environmentWith(const Words& additions) {
  char** environment = g_get_environ();
  for (const auto& addition : additions) {
    const size_t equals = addition.find('=');
    environment = g_environ_setenv(environment, addition.substr(0, equals).c_str(),
                                   addition.substr(equals + 1).c_str(), TRUE);
  }
  return environment;
}

std::string take(char* text) {
  std::string result = text ? text : "";
  g_free(text);
  return result;
}

}  // namespace

Output run(const Words& words, const Words& environment) {
  std::vector<char*> argv;
  for (const auto& word : words) argv.push_back(const_cast<char*>(word.c_str()));
  argv.push_back(nullptr);
  const std::unique_ptr<char*, decltype(&g_strfreev)> env(environmentWith(environment), g_strfreev);
  char *out = nullptr, *err = nullptr;
  int status = 0;
  GError* error = nullptr;
  if (!g_spawn_sync(nullptr, argv.data(), env.get(), G_SPAWN_SEARCH_PATH, nullptr, nullptr, &out,
                    &err, &status, &error)) {
    const std::unique_ptr<GError, FreeError> owner(error);
    ADD_FAILURE() << words[0] << ": " << error->message;
    return {};
  }
  Output output{WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status), take(out), take(err)};
  return output;
}

}  // namespace phone
