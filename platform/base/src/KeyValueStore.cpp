#include <base/KeyValueStore.h>

#include "StoreConnection.h"

#include <common/DamagedDatabase.h>
#include <dlog.h>
#include <unistd.h>

#include <utility>

namespace base {
namespace {

constexpr const char* kTag = "PLATFORM";

bool damaged(int code) {
  return code == SQLITE_CORRUPT || code == SQLITE_NOTADB;
}

std::string folderOf(const std::string& path) {
  common::OwnedText folder(g_path_get_dirname(path.c_str()));
  return folder.get();
}

}  // namespace

KeyValueStore::KeyValueStore(std::string path, Reads reads)
    : _path(std::move(path)), _reads(reads) {}

KeyValueStore::~KeyValueStore() {
  endTurn();
}

int KeyValueStore::connect(bool create) {
  if (_connection) return SQLITE_OK;
  if (create) g_mkdir_with_parents(folderOf(_path).c_str(), 0700);
  auto connection = std::make_unique<StoreConnection>();
  const int code = connection->open(_path, create);
  if (code == SQLITE_OK) _connection = std::move(connection);
  return code;
}

bool KeyValueStore::moveAsideIfDamaged() {
  _connection.reset();
  const common::Examined examined = common::examineDatabase(_path, _path + ".corrupt");
  if (examined == common::Examined::SetAside) {
    dlog_print(DLOG_ERROR, kTag, "%s was damaged; it is now .corrupt and a new one is begun",
               _path.c_str());
  }
  return examined != common::Examined::Unusable;
}

template <typename Operation>
KeyValueStore::Answer KeyValueStore::run(bool create, Operation operation) {
  if (!create && !_connection && access(_path.c_str(), F_OK) != 0) return Answer::NoKey;
  auto attempt = [&] {
    const int code = connect(create);
    return code == SQLITE_OK ? operation(*_connection) : code;
  };
  int code = attempt();
  if (damaged(code) && moveAsideIfDamaged()) {
    create = true;
    code = attempt();
  }
  if (code == SQLITE_ROW || code == SQLITE_OK) return Answer::Done;
  if (code == SQLITE_DONE) return Answer::NoKey;
  dlog_print(DLOG_ERROR, kTag, "%s: %s", _path.c_str(), sqlite3_errstr(code));
  return Answer::Failed;
}

void KeyValueStore::beginTurn(StoreConnection& connection) {
  // Who is not called by the loop may just have heard of a change, and its turn would never end.
  const bool isCalledByLoop = g_main_depth() > 0;
  if (!isCalledByLoop) endTurn();
  if (!isCalledByLoop || _turn || _reads == Reads::Fresh) return;
  connection.beginReading();
  _turn = g_idle_add_full(G_PRIORITY_HIGH, turnEndedCb, this, nullptr);
}

void KeyValueStore::endTurn() {
  if (!_turn) return;
  g_source_remove(std::exchange(_turn, 0));
  if (_connection) _connection->endReading();
}

int KeyValueStore::turnEndedCb(void* self) {
  static_cast<KeyValueStore*>(self)->endTurn();
  return G_SOURCE_REMOVE;
}

template <typename Operation>
KeyValueStore::Answer KeyValueStore::read(Operation operation) {
  return run(false, [&](StoreConnection& store) {
    beginTurn(store);
    return operation(store);
  });
}

template <typename Operation>
KeyValueStore::Answer KeyValueStore::write(bool create, Operation operation) {
  endTurn();
  return run(create, operation);
}

KeyValueStore::Answer KeyValueStore::get(const std::string& key, Value& value) {
  return read([&](StoreConnection& store) { return store.get(key, value); });
}

KeyValueStore::Answer KeyValueStore::set(const std::string& key, const Value& value) {
  const Answer answer = write(true, [&](StoreConnection& store) { return store.set(key, value); });
  return answer == Answer::NoKey ? Answer::Done : answer;
}

KeyValueStore::Answer KeyValueStore::remove(const std::string& key) {
  return write(false, [&](StoreConnection& store) { return store.remove(key); });
}

KeyValueStore::Answer KeyValueStore::removeAll() {
  const Answer answer = write(false, [](StoreConnection& store) { return store.removeAll(); });
  return answer == Answer::NoKey ? Answer::Done : answer;
}

KeyValueStore::Answer KeyValueStore::keys(std::vector<std::string>& keys) {
  keys.clear();
  const Answer answer = read([&](StoreConnection& store) { return store.keys(keys); });
  return answer == Answer::NoKey ? Answer::Done : answer;
}

}  // namespace base
