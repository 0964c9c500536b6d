/// Changes the phone's address book, for tools and companion applications.
#pragma once

#include <memory>
#include <string>
#include <vector>

namespace contacts {

class AddressBookEditor {
 public:
  struct Entry {
    std::string name;
    std::vector<std::string> numbers;
    std::string picture;  ///< path of a picture file, empty without one
  };

  /// Opens the address book; check isOpen().
  AddressBookEditor();
  ~AddressBookEditor();
  AddressBookEditor(const AddressBookEditor&) = delete;
  AddressBookEditor& operator=(const AddressBookEditor&) = delete;

  bool isOpen() const;

  /// All return when the address book has stored the change. False, with the reason in `error`,
  /// when it was not made.
  bool add(const Entry& entry, std::string& error);
  bool add(const std::vector<Entry>& entries, std::string& error);
  /// All contacts of a vCard file's text.
  bool import(const std::string& vcards, std::string& error);
  /// Every contact of that name.
  bool rename(const std::string& from, const std::string& to, std::string& error);
  bool remove(const std::string& name, std::string& error);
  std::vector<Entry> all();

 private:
  struct Private;
  std::unique_ptr<Private> _d;
};

}  // namespace contacts
