// The language of the phone's own applications is that of the phone.

#include "Companions.h"

using phone::thePhone;

namespace {

class Language : public testing::Test {
 protected:
  void TearDown() override { thePhone()({"language", "en_US.UTF-8"}); }
};

}  // namespace

TEST_F(Language, IsThatOfThePhone) {
  thePhone()({"account", "none"});
  thePhone()({"language", "de_DE.UTF-8"});
  open(kSignUp);
  EXPECT_TRUE(comes("Um Dateien zu teilen, registrieren Sie sich"));
  EXPECT_TRUE(comes("Registrieren"));
  open(kPicker);
  EXPECT_TRUE(comes("Empfänger wählen"));
  EXPECT_TRUE(comes("Zurück"));
  open(kDownloads);
  EXPECT_TRUE(comes("Liste leeren"));
}

TEST_F(Language, ChangesWhileAnApplicationIsOpen) {
  open(kHistory);
  ASSERT_TRUE(comes("Sharing history"));
  thePhone()({"language", "ko_KR.UTF-8"});
  EXPECT_TRUE(comes("공유 기록"));
  EXPECT_TRUE(comes("다운로드"));
  thePhone()({"language", "en_US.UTF-8"});
  EXPECT_TRUE(comes("Sharing history"));
  EXPECT_TRUE(comes("Downloads"));
}
