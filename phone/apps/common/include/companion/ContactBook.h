#pragma once

#include <functional>
#include <string>
#include <vector>

namespace companion {

/// The phone's address book.
class ContactBook {
 public:
  struct Entry {
    std::string name;
    std::string number;
    std::string picture;  ///< path, empty for none
  };

  /// `onChange` is called on the main loop when the address book changes; may be empty.
  explicit ContactBook(std::function<void()> onChange = {});
  ~ContactBook();
  ContactBook(const ContactBook&) = delete;
  ContactBook& operator=(const ContactBook&) = delete;

  /// The name of whoever has the number, or the number itself.
  std::string nameOf(const std::string& number) const;
  /// Everybody with a number, one entry per number, by name.
  std::vector<Entry> all() const;

 private:
  static void _changedCb(const char* viewUri, void* data);

  std::function<void()> _onChange;
};

}  // namespace companion
