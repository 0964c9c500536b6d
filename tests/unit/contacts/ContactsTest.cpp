// The address book, as applications see it. Runs on a phone: the address book is the phone's own.

#include <common/Owned.h>
#include <contacts.h>
#include <contacts/AddressBookEditor.h>
#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <vector>

namespace {

using contacts::AddressBookEditor;
using Texts = std::vector<std::string>;

constexpr int kPatienceMs = 5000;

bool waitFor(const std::function<bool()>& condition) {
  bool late = false;
  const guint timer = g_timeout_add_once(
      kPatienceMs, [](gpointer data) { *static_cast<bool*>(data) = true; }, &late);
  while (!condition() && !late) g_main_context_iteration(nullptr, TRUE);
  if (!late) g_source_remove(timer);
  return condition();
}

Texts textsOf(contacts_list_h list, unsigned int property) {
  Texts texts;
  int error = contacts_list_first(list);
  for (; error == CONTACTS_ERROR_NONE; error = contacts_list_next(list)) {
    contacts_record_h record = nullptr;
    char* text = nullptr;
    contacts_list_get_current_record_p(list, &record);
    contacts_record_get_str_p(record, property, &text);
    texts.emplace_back(text ? text : "(not set)");
  }
  contacts_list_destroy(list, true);
  return texts;
}

Texts find(unsigned int property, contacts_match_str_flag_e match, const char* value,
           unsigned int wanted = _contacts_person_number.display_name) {
  contacts_filter_h filter = nullptr;
  contacts_query_h query = nullptr;
  contacts_list_h list = nullptr;
  contacts_filter_create(_contacts_person_number._uri, &filter);
  contacts_filter_add_str(filter, property, match, value);
  contacts_query_create(_contacts_person_number._uri, &query);
  contacts_query_set_filter(query, filter);
  contacts_query_set_sort(query, _contacts_person_number.display_name, true);
  EXPECT_EQ(contacts_db_get_records_with_query(query, 0, 0, &list), CONTACTS_ERROR_NONE);
  contacts_query_destroy(query);
  contacts_filter_destroy(filter);
  return textsOf(list, wanted);
}

Texts byNumber(const char* number) {
  return find(_contacts_person_number.number, CONTACTS_MATCH_CONTAINS, number);
}

class Contacts : public ::testing::Test {
 protected:
  static void SetUpTestSuite() {
    ASSERT_TRUE(editor().isOpen()) << "is this a phone?";
    ASSERT_TRUE(editor().all().empty()) << "these contacts would be lost";
  }
  static void TearDownTestSuite() { delete &editor(); }

  void SetUp() override { ASSERT_EQ(contacts_connect(), CONTACTS_ERROR_NONE); }

  /// Returns when the service knows that there is nobody, for the next test asks it.
  void TearDown() override {
    contacts_disconnect();  // and the test's callbacks are gone
    std::string error;
    for (const auto& entry : editor().all()) editor().remove(entry.name, error);
    ASSERT_EQ(contacts_connect(), CONTACTS_ERROR_NONE);
    EXPECT_TRUE(waitFor([] { return everybody() == 0; }));
    contacts_disconnect();
  }

  static int everybody() {
    contacts_list_h list = nullptr;
    int count = -1;
    contacts_db_get_all_records(_contacts_person._uri, 0, 0, &list);
    contacts_list_get_count(list, &count);
    contacts_list_destroy(list, true);
    return count;
  }

  static AddressBookEditor& editor() {
    static auto* editor = new AddressBookEditor;
    return *editor;
  }

  /// Returns when the connection of the test knows them.
  static void add(const std::vector<AddressBookEditor::Entry>& entries) {
    std::string error;
    ASSERT_TRUE(editor().add(entries, error)) << error;
    const auto& last = entries.back();
    ASSERT_TRUE(waitFor([&] { return !byNumber(last.numbers[0].c_str()).empty(); }));
  }
};

struct Count {
  static void changed(const char* uri, void* data) {
    auto* self = static_cast<Count*>(data);
    self->calls++;
    self->uri = uri;
  }
  int calls = 0;
  std::string uri;
};

}  // namespace

TEST_F(Contacts, FindsANumberHoweverItWasWritten) {
  add({{"A", {"+15550100001"}, ""},
       {"B", {"+1 555-010-0001"}, ""},
       {"C", {"(555) 010-0001"}, ""},
       {"D", {"555 010 0001"}, ""},
       {"E", {"05550100001"}, ""}});
  EXPECT_EQ(byNumber("5550100001"), (Texts{"A", "B", "C", "D", "E"}));
  EXPECT_EQ(byNumber("555-010-0001"), (Texts{"A", "B", "C", "D", "E"}));
}

TEST_F(Contacts, FindsAStoredNumberThatHasACountryPrefixBySuffix) {
  add({{"Mina", {"+821011112222"}, ""}});
  EXPECT_EQ(byNumber("1011112222"), Texts{"Mina"});
  EXPECT_EQ(byNumber("+821011112222"), Texts{"Mina"});
}

TEST_F(Contacts, DoesNotFindALongerNumberThanTheStoredOne) {
  add({{"Mina", {"1011112222"}, ""}});
  EXPECT_EQ(byNumber("+821011112222"), Texts{});
}

TEST_F(Contacts, TakesThePlusForAPartOfTheNumber) {
  add({{"Mina", {"0821011112222"}, ""}});
  EXPECT_EQ(byNumber("+821011112222"), Texts{});
  EXPECT_EQ(byNumber("821011112222"), Texts{"Mina"});
}

TEST_F(Contacts, FindsNobodyForATextWithoutDigits) {
  add({{"Mina", {"+821011112222"}, ""}});
  EXPECT_EQ(byNumber(""), Texts{});
  EXPECT_EQ(byNumber("+"), Texts{});
  EXPECT_EQ(byNumber("Mina"), Texts{});
}

TEST_F(Contacts, AnswersNobodyWithSuccessAndAnEmptyList) {
  contacts_list_h list = nullptr;
  ASSERT_EQ(contacts_db_get_all_records(_contacts_person_number._uri, 0, 0, &list),
            CONTACTS_ERROR_NONE);
  int count = -1;
  EXPECT_EQ(contacts_list_get_count(list, &count), CONTACTS_ERROR_NONE);
  EXPECT_EQ(count, 0);
  contacts_record_h record = nullptr;
  EXPECT_EQ(contacts_list_get_current_record_p(list, &record), CONTACTS_ERROR_NO_DATA);
  EXPECT_EQ(contacts_list_first(list), CONTACTS_ERROR_NO_DATA);
  contacts_list_destroy(list, true);
}

TEST_F(Contacts, HasOneRecordPerNumberOfAPerson) {
  add({{"Mina", {"+821011112222", "+82212345678"}, ""}});
  contacts_list_h list = nullptr;
  contacts_db_get_all_records(_contacts_person_number._uri, 0, 0, &list);
  EXPECT_EQ(textsOf(list, _contacts_person_number.number).size(), 2u);
  contacts_db_get_all_records(_contacts_person._uri, 0, 0, &list);
  EXPECT_EQ(textsOf(list, _contacts_person.display_name), Texts{"Mina"});
}

TEST_F(Contacts, TreatsAnEmptyNameAsNotSet) {
  add({{"", {"+821011112222"}, ""}});
  EXPECT_EQ(byNumber("+821011112222"), Texts{"(not set)"});
}

TEST_F(Contacts, GivesThePictureAsTheNameOfAFile) {
  const std::string path = std::string(g_get_tmp_dir()) + "/contact-picture.png";
  constexpr char kPng[] = "\x89PNG\r\n\x1a\nnot more than its beginning";
  ASSERT_TRUE(g_file_set_contents(path.c_str(), kPng, sizeof kPng, nullptr));
  add({{"Mina", {"+821011112222"}, path}});
  const Texts pictures = find(_contacts_person_number.number, CONTACTS_MATCH_CONTAINS,
                              "+821011112222", _contacts_person_number.image_thumbnail_path);
  ASSERT_EQ(pictures.size(), 1u);
  common::OwnedText data;
  gsize size = 0;
  ASSERT_TRUE(g_file_get_contents(pictures[0].c_str(), common::Out(data), &size, nullptr))
      << pictures[0];
  EXPECT_EQ(std::string(data.get(), size), std::string(kPng, sizeof kPng));
}

TEST_F(Contacts, ComparesNamesWithoutCaseUnlessExactly) {
  add({{"Élodie Martin", {"+33155501000"}, ""}});
  const auto name = _contacts_person_number.display_name;
  EXPECT_EQ(find(name, CONTACTS_MATCH_CONTAINS, "LODIE m").size(), 1u);
  EXPECT_EQ(find(name, CONTACTS_MATCH_STARTSWITH, "élo").size(), 1u);
  EXPECT_EQ(find(name, CONTACTS_MATCH_ENDSWITH, "TIN").size(), 1u);
  EXPECT_EQ(find(name, CONTACTS_MATCH_FULLSTRING, "élodie martin").size(), 1u);
  EXPECT_EQ(find(name, CONTACTS_MATCH_EXACTLY, "élodie martin").size(), 0u);
  EXPECT_EQ(find(name, CONTACTS_MATCH_EXISTS, nullptr).size(), 1u);
}

TEST_F(Contacts, GivesThePartOfTheRecordsThatWasAskedFor) {
  add({{"A", {"+1001"}, ""}, {"B", {"+1002"}, ""}, {"C", {"+1003"}, ""}});
  contacts_query_h query = nullptr;
  contacts_list_h list = nullptr;
  contacts_query_create(_contacts_person_number._uri, &query);
  contacts_query_set_sort(query, _contacts_person_number.display_name, false);
  contacts_db_get_records_with_query(query, 1, 1, &list);
  EXPECT_EQ(textsOf(list, _contacts_person_number.display_name), Texts{"B"});
  contacts_db_get_records_with_query(query, 7, 0, &list);
  EXPECT_EQ(textsOf(list, _contacts_person_number.display_name), Texts{});
  EXPECT_EQ(contacts_db_get_records_with_query(query, -1, 0, &list),
            CONTACTS_ERROR_INVALID_PARAMETER);
  contacts_query_destroy(query);
}

TEST_F(Contacts, BindAndTighterThanOr) {
  add({{"A", {"+1001"}, ""}, {"B", {"+1002"}, ""}, {"C", {"+1003"}, ""}});
  const auto& view = _contacts_person_number;
  contacts_filter_h filter = nullptr;
  contacts_query_h query = nullptr;
  contacts_list_h list = nullptr;
  contacts_filter_create(view._uri, &filter);
  contacts_filter_add_str(filter, view.display_name, CONTACTS_MATCH_EXACTLY, "C");
  contacts_filter_add_operator(filter, CONTACTS_FILTER_OPERATOR_OR);
  contacts_filter_add_str(filter, view.display_name, CONTACTS_MATCH_EXACTLY, "A");
  contacts_filter_add_operator(filter, CONTACTS_FILTER_OPERATOR_AND);
  contacts_filter_add_str(filter, view.number, CONTACTS_MATCH_ENDSWITH, "2");
  contacts_query_create(view._uri, &query);
  contacts_query_set_filter(query, filter);
  contacts_filter_destroy(filter);  // before the query runs
  contacts_db_get_records_with_query(query, 0, 0, &list);
  contacts_query_destroy(query);
  EXPECT_EQ(textsOf(list, view.display_name), Texts{"C"});
}

TEST_F(Contacts, MergesTheNewsOfManyChanges) {
  constexpr int kMany = 100;
  Count count;
  ASSERT_EQ(contacts_db_add_changed_cb(_contacts_person._uri, Count::changed, &count),
            CONTACTS_ERROR_NONE);
  std::vector<AddressBookEditor::Entry> entries;
  entries.reserve(kMany);
  for (int i = 0; i < kMany; i++) entries.push_back({"A", {"+" + std::to_string(1000 + i)}, ""});
  add(entries);
  EXPECT_TRUE(waitFor([&] { return byNumber("+1").size() == kMany && count.calls > 0; }));
  EXPECT_LT(count.calls, kMany / 2);
  EXPECT_EQ(count.uri, _contacts_person._uri);
}

TEST_F(Contacts, SaysThatAContactWasRenamedAndThenHasTheNewName) {
  add({{"Old", {"+1001"}, ""}});
  Count count;
  contacts_db_add_changed_cb(_contacts_person._uri, Count::changed, &count);
  std::string error;
  ASSERT_TRUE(editor().rename("Old", "New", error)) << error;
  EXPECT_TRUE(waitFor([&] { return byNumber("+1001") == Texts{"New"}; }));
  EXPECT_TRUE(waitFor([&] { return count.calls > 0; }));
}

TEST_F(Contacts, ForgetsARemovedContact) {
  add({{"Old", {"+1001"}, ""}});
  std::string error;
  ASSERT_TRUE(editor().remove("Old", error)) << error;
  EXPECT_TRUE(waitFor([] { return byNumber("+1001").empty(); }));
}

TEST_F(Contacts, NoLongerCallsACallbackThatWasRemoved) {
  Count removed, kept;
  contacts_db_add_changed_cb(_contacts_person._uri, Count::changed, &removed);
  contacts_db_add_changed_cb(_contacts_person._uri, Count::changed, &kept);
  EXPECT_EQ(contacts_db_remove_changed_cb(_contacts_person._uri, Count::changed, &removed),
            CONTACTS_ERROR_NONE);
  EXPECT_EQ(contacts_db_remove_changed_cb(_contacts_person._uri, Count::changed, &removed),
            CONTACTS_ERROR_NO_DATA);
  add({{"A", {"+1001"}, ""}});
  EXPECT_TRUE(waitFor([&] { return kept.calls > 0; }));
  EXPECT_EQ(removed.calls, 0);
}

TEST_F(Contacts, StaysConnectedUntilTheLastUserLeaves) {
  ASSERT_EQ(contacts_connect(), CONTACTS_ERROR_NONE);
  EXPECT_EQ(contacts_disconnect(), CONTACTS_ERROR_NONE);
  EXPECT_EQ(byNumber("+1"), Texts{});
}

TEST(ContactsWithoutConnection, RefuseEverythingThatNeedsOne) {
  contacts_list_h list = nullptr;
  Count count;
  EXPECT_EQ(contacts_disconnect(), CONTACTS_ERROR_DB);
  EXPECT_EQ(contacts_db_add_changed_cb(_contacts_person._uri, Count::changed, &count),
            CONTACTS_ERROR_DB);
  EXPECT_EQ(contacts_db_remove_changed_cb(_contacts_person._uri, Count::changed, &count),
            CONTACTS_ERROR_NO_DATA);
  EXPECT_EQ(contacts_db_get_all_records(_contacts_person._uri, 0, 0, &list), CONTACTS_ERROR_DB);
}

TEST(ContactsFilter, RefusesWhatIsNoFilter) {
  contacts_filter_h filter = nullptr;
  contacts_query_h query = nullptr;
  EXPECT_EQ(contacts_filter_create("no view", &filter), CONTACTS_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(contacts_filter_create(nullptr, &filter), CONTACTS_ERROR_INVALID_PARAMETER);
  ASSERT_EQ(contacts_filter_create(_contacts_person._uri, &filter), CONTACTS_ERROR_NONE);
  ASSERT_EQ(contacts_query_create(_contacts_person._uri, &query), CONTACTS_ERROR_NONE);
  EXPECT_EQ(contacts_query_set_filter(query, filter), CONTACTS_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(contacts_filter_add_operator(filter, CONTACTS_FILTER_OPERATOR_AND),
            CONTACTS_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(contacts_filter_add_str(filter, _contacts_person.display_name, CONTACTS_MATCH_CONTAINS,
                                    nullptr),
            CONTACTS_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(contacts_filter_add_str(filter, _contacts_person.display_name, CONTACTS_MATCH_CONTAINS,
                                    "\xff"),
            CONTACTS_ERROR_INVALID_PARAMETER);
  contacts_filter_destroy(filter);
  contacts_query_destroy(query);
}
