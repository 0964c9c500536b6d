#include "ServiceProcess.h"

#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>

ServiceProcess::ServiceProcess(const std::string& data, const std::vector<std::string>& arguments) {
  std::vector<std::string> words = {SERVICE_PROGRAM, "--data", data};
  words.insert(words.end(), arguments.begin(), arguments.end());
  std::vector<char*> argv;
  for (std::string& word : words) argv.push_back(word.data());
  argv.push_back(nullptr);

  int output[2];
  if (pipe(output) != 0) abort();
  posix_spawn_file_actions_t actions;
  posix_spawn_file_actions_init(&actions);
  posix_spawn_file_actions_adddup2(&actions, output[1], STDOUT_FILENO);
  posix_spawn_file_actions_addclose(&actions, output[0]);
  posix_spawn_file_actions_addclose(&actions, output[1]);
  const int failed = posix_spawn(&_pid, argv[0], &actions, nullptr, argv.data(), environ);
  posix_spawn_file_actions_destroy(&actions);
  close(output[1]);
  if (failed) _pid = -1;

  char line[256] = "";
  FILE* file = fdopen(output[0], "r");
  if (fgets(line, sizeof line, file) && strncmp(line, "ready: ", 7) == 0) {
    _url = line + 7;
    _url.erase(_url.find_last_not_of('\n') + 1);
  }
  fclose(file);
}

ServiceProcess::~ServiceProcess() {
  stop();
}

int ServiceProcess::stop() {
  if (_pid < 0) return -1;
  kill(_pid, SIGTERM);
  int status = 0;
  waitpid(_pid, &status, 0);
  _pid = -1;
  return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}
