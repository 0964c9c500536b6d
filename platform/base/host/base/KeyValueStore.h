/// A persistent key-value store, shared by processes: one SQLite file. Any bytes without a zero are
/// a key. Calls are synchronous and wait at most half a second for another process. For one thread.
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

  enum class Reads {
    Fresh,  ///< what the file holds at the call
    /// What the file held at the first of the reads that one callback of the main loop makes, or
    /// after a write of this store. A read that shares its transaction takes half the time.
    OfOneTurn,
  };

  /// The file and its folder are made by the first write.
  explicit KeyValueStore(std::string path, Reads reads = Reads::Fresh);
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
  template <typename Operation>
  Answer read(Operation operation);
  template <typename Operation>
  Answer write(bool create, Operation operation);
  int connect(bool create);
  bool moveAsideIfDamaged();
  void beginTurn(StoreConnection& connection);
  void endTurn();
  static int turnEndedCb(void* self);

  const std::string _path;
  const Reads _reads;
  unsigned _turn = 0;  ///< the source that ends it
  std::unique_ptr<StoreConnection> _connection;
};

}  // namespace base
