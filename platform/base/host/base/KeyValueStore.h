/// A persistent key-value store, shared by processes: one SQLite file. Any bytes without a zero are
/// a key. Calls are synchronous and wait at most half a second for another process.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <variant>
#include <vector>

namespace base {

class StoreConnection;

class KeyValueStore {
 public:
  using Value = std::variant<std::string, int64_t>;
  enum class Answer { Done, NoKey, Failed };

  /// The file and its folder are made by the first write.
  explicit KeyValueStore(std::string path);
  ~KeyValueStore();
  KeyValueStore(const KeyValueStore&) = delete;
  KeyValueStore& operator=(const KeyValueStore&) = delete;

  Answer get(const std::string& key, Value& value);
  Answer set(const std::string& key, const Value& value);
  Answer remove(const std::string& key);
  Answer removeAll();
  /// Sorted.
  Answer keys(std::vector<std::string>& keys);

 private:
  template <typename Operation>
  Answer run(bool create, Operation operation);
  int connect(bool create);
  bool moveAsideIfDamaged();

  const std::string _path;
  std::unique_ptr<StoreConnection> _connection;
};

}  // namespace base
