#include "ViewerTest.h"
#include "ZQVContacts.h"

namespace {

constexpr const char* kGroup =
    "/opt/usr/apps/com.orlant.zelqo/res/images/viewer-images/WVGA/zq_caller_id_default_group.png";
constexpr const char* kPerson =
    "/opt/usr/apps/com.orlant.zelqo/res/images/viewer-images/WVGA/"
    "contacts_caller_id_default_02.png";

class Contacts : public ViewerTest {
 protected:
  void TearDown() override { EXPECT_EQ(platform().openContactHandles, 0); }

  static std::string nameOf(const char* number) {
    return taken(ZQVContacts::_getContactName(number));
  }
  std::string textOf(std::vector<const char*> numbers) {
    _recipients.clear();
    _pointers.clear();
    for (const char* number : numbers) _recipients.push_back({0, const_cast<char*>(number)});
    for (auto& recipient : _recipients) _pointers.push_back(&recipient);
    return ZQVContacts::recipientsText(_pointers.data(), static_cast<uint32_t>(_pointers.size()));
  }
  std::string imageOf(std::vector<const char*> numbers) {
    textOf(numbers);
    return ZQVContacts::recipientsImage(_pointers.data(), static_cast<uint32_t>(_pointers.size()));
  }

 private:
  std::vector<zelqo_recipient_s> _recipients;
  std::vector<zelqo_recipient_s*> _pointers;
};

TEST_F(Contacts, KnowAPersonByANumberThatContainsTheGivenOne) {
  platform().contacts = {{"+821012345678", "Anna", {}}};
  EXPECT_EQ(nameOf("1012345678"), "Anna");
  EXPECT_EQ(nameOf("+821012345678"), "Anna");
  EXPECT_EQ(nameOf("+491012345678"), "(null)");
}

TEST_F(Contacts, AreAskedForDigitsAndALeadingPlus) {
  nameOf("+82 (10) 1234-5678");
  nameOf("010+1234");
  EXPECT_EQ(platform().contactQueries, Errors({"+821012345678", "0101234"}));
}

TEST_F(Contacts, AreNotAskedForNoNumber) {
  EXPECT_EQ(nameOf(""), "(null)");
  EXPECT_EQ(nameOf(nullptr), "(null)");
  EXPECT_EQ(nameOf("+"), "(null)");
  EXPECT_EQ(nameOf("nobody"), "(null)");
  EXPECT_EQ(ZQVContacts::_getContactImagePath(""), "");
  EXPECT_TRUE(platform().contactQueries.empty());
}

TEST_F(Contacts, GiveTheFirstNameThatIsSet) {
  platform().contacts = {{"10", {}, {}}, {"10", "", {}}, {"10", "Berta", {}}, {"10", "Carla", {}}};
  EXPECT_EQ(nameOf("10"), "Berta");
}

TEST_F(Contacts, GiveTheLastPictureThatIsSet) {
  platform().contacts = {{"10", {}, "/a.png"}, {"10", {}, "/b.png"}, {"10", {}, {}}};
  EXPECT_EQ(ZQVContacts::_getContactImagePath("10"), "/b.png");
}

TEST_F(Contacts, FallBackToTheNumberWhenTheyCannotBeAsked) {
  platform().contactsError = -33619809;
  EXPECT_EQ(ZQVContacts::nameOrNumber("+8210"), "+8210");
  EXPECT_EQ(ZQVContacts::_getContactImagePath("+8210"), "");
  EXPECT_EQ(errors(),
            Errors({"contacts_db_get_records_with_query is failed error_code = -33619809",
                    "contacts_db_get_records_with_query is failed error_code = -33619809"}));
}

TEST_F(Contacts, JoinRecipientsWithAComma) {
  platform().contacts = {{"+8210", "Anna", {}}};
  EXPECT_EQ(textOf({"+8210", "+8220"}), "Anna,+8220");
  EXPECT_EQ(textOf({"+8220"}), "+8220");
  EXPECT_EQ(textOf({}), "");
}

TEST_F(Contacts, ShowTheGroupPictureForSeveralRecipients) {
  platform().contacts = {{"+8210", "Anna", "/anna.png"}};
  EXPECT_EQ(imageOf({"+8210", "+8220"}), kGroup);
}

TEST_F(Contacts, ShowTheOneRecipientsPictureOrItsDefault) {
  platform().contacts = {{"+8210", "Anna", "/anna.png"}};
  EXPECT_EQ(imageOf({"+8210"}), "/anna.png");
  EXPECT_EQ(imageOf({"+8220"}), kPerson);
  EXPECT_EQ(ZQVContacts::recipientsImage(nullptr, 0), kPerson);
}

TEST_F(Contacts, SurviveRecipientsWithoutANumber) {
  zelqo_recipient_s* nobody[] = {nullptr, nullptr};
  EXPECT_EQ(ZQVContacts::recipientsText(nobody, 2), ",");
  EXPECT_EQ(ZQVContacts::recipientsImage(nobody, 1), kPerson);
}

}  // namespace
