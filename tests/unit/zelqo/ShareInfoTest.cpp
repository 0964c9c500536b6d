#include <glib.h>
#include <gtest/gtest.h>
#include <zelqo.h>
#include <zelqo/Store.h>

#include <cstdlib>

#include "FakeSettings.h"
#include "TestShares.h"

namespace {

std::string taken(char* text) {
  std::string copy = text ? text : "(null)";
  free(text);
  return copy;
}

using Getter = int (*)(zelqo_share_h, unsigned int, char**);

constexpr Getter kTexts[] = {
    zelqo_content_info_get_file_name,         zelqo_content_info_get_content_type,
    zelqo_content_info_get_thumbnail_url,     zelqo_content_info_get_mid_thumbnail_url,
    zelqo_content_info_get_big_thumbnail_url, zelqo_content_info_get_download_url};

class ShareInfo : public testing::Test {
 protected:
  ShareInfo() { setServiceUrl("http://service:1/"); }

  zelqo_share_h received(const std::string& token) {
    zelqo_share_h handle = nullptr;
    EXPECT_EQ(zelqo_push_info_get_handle(token.c_str(), &handle), 0);
    return handle;
  }
  std::string text(Getter getter, zelqo_share_h handle, unsigned int index) {
    char* out = nullptr;
    getter(handle, index, &out);
    return taken(out);
  }
  unsigned long long end(zelqo_share_h handle) {
    unsigned long long time = 0;
    EXPECT_EQ(zelqo_push_info_get_expired_time(handle, &time), 0);
    return time;
  }

  zelqo::Store _store;
};

TEST_F(ShareInfo, AnswersWhatTheStoreKnows) {
  _store.addReceived(receivedShare("answers"));
  const zelqo_share_h handle = received("answers");
  char* sender = nullptr;
  unsigned int number = 0;
  EXPECT_EQ(zelqo_push_info_get_sender_msisdn(handle, &sender), 0);
  EXPECT_STREQ(sender, "+821011112222");
  EXPECT_EQ(zelqo_push_info_get_content_info_count(handle, &number), 0);
  EXPECT_EQ(number, 2U);
  EXPECT_EQ(zelqo_content_info_get_file_size(handle, 1, &number), 0);
  EXPECT_EQ(number, 200U);
  EXPECT_EQ(end(handle), 4102444800000U);
  EXPECT_EQ(text(zelqo_content_info_get_file_name, handle, 0), "a.jpg");
  EXPECT_EQ(text(zelqo_content_info_get_content_type, handle, 1), "text/plain");
}

TEST_F(ShareInfo, GivesCompleteAddresses) {
  zelqo::ReceivedShare share = receivedShare("addresses");
  share.files[1].thumb = "https://elsewhere/x y\"../z";
  _store.addReceived(share);
  const zelqo_share_h handle = received("addresses");
  const std::string base = "http://service:1/share/addresses/";
  EXPECT_EQ(text(zelqo_content_info_get_thumbnail_url, handle, 0), base + "thumb/0");
  EXPECT_EQ(text(zelqo_content_info_get_mid_thumbnail_url, handle, 0), base + "mid/0");
  EXPECT_EQ(text(zelqo_content_info_get_big_thumbnail_url, handle, 0), base + "big/0");
  EXPECT_EQ(text(zelqo_content_info_get_download_url, handle, 1), base + "file/1");
  EXPECT_EQ(text(zelqo_content_info_get_thumbnail_url, handle, 1), "https://elsewhere/x y\"../z");
}

TEST_F(ShareInfo, PrefersTheSharesOwnAddress) {
  zelqo::ReceivedShare share = receivedShare("own-address");
  share.base = "https://cdn.example/share/own-address";
  _store.addReceived(share);
  EXPECT_EQ(text(zelqo_content_info_get_thumbnail_url, received("own-address"), 0),
            share.base + "/thumb/0");
}

TEST_F(ShareInfo, HasNoAddressWithoutAService) {
  _store.addReceived(receivedShare("no-service"));
  setServiceUrl("");
  char* out = nullptr;
  EXPECT_EQ(zelqo_content_info_get_thumbnail_url(received("no-service"), 0, &out),
            ZELQO_ERROR_NO_DATA);
  EXPECT_EQ(out, nullptr);
}

TEST_F(ShareInfo, SaysWhichTextsAShareLacks) {
  zelqo::ReceivedShare share = receivedShare("gaps");
  share.files = {{}};
  _store.addReceived(share);
  const zelqo_share_h handle = received("gaps");
  for (const Getter getter : kTexts) {
    char* out = reinterpret_cast<char*>(1);
    EXPECT_EQ(getter(handle, 0, &out), ZELQO_ERROR_NO_DATA);
    EXPECT_EQ(out, nullptr);
  }
  unsigned int size = 1;
  EXPECT_NE(zelqo_content_info_get_file_size(handle, 0, &size), 0);
  EXPECT_EQ(size, 0U);
}

TEST_F(ShareInfo, RefusesAnIndexBeyondTheFiles) {
  _store.addReceived(receivedShare("index"));
  const zelqo_share_h handle = received("index");
  for (const unsigned int index : {2U, 10000U, ~0U}) {
    for (const Getter getter : kTexts) {
      char* out = reinterpret_cast<char*>(1);
      EXPECT_NE(getter(handle, index, &out), 0);
      EXPECT_EQ(out, nullptr);
    }
    unsigned int size = 1;
    EXPECT_NE(zelqo_content_info_get_file_size(handle, index, &size), 0);
    EXPECT_EQ(size, 0U);
  }
}

TEST_F(ShareInfo, RefusesWhatIsNoHandle) {
  _store.addSent(sentShare(77, "kinds"));
  zelqo_share_h sent = nullptr;
  ASSERT_EQ(zelqo_upload_info_get_handle(77, &sent), 0);
  unsigned int count = 1;
  char* out = nullptr;
  int stranger = 0;
  for (const zelqo_share_h handle :
       {zelqo_share_h{nullptr}, sent, reinterpret_cast<zelqo_share_h>(&stranger)}) {
    EXPECT_NE(zelqo_push_info_get_content_info_count(handle, &count), 0);
    EXPECT_NE(zelqo_push_info_get_sender_msisdn(handle, &out), 0);
    EXPECT_NE(zelqo_content_info_get_file_name(handle, 0, &out), 0);
  }
  EXPECT_NE(zelqo_push_info_get_handle("x", nullptr), 0);
  EXPECT_NE(zelqo_push_info_get_handle(nullptr, &sent), 0);
  EXPECT_EQ(sent, nullptr);
}

TEST_F(ShareInfo, KnowsNoUnknownShare) {
  zelqo_share_h handle = reinterpret_cast<zelqo_share_h>(1);
  EXPECT_EQ(zelqo_push_info_get_handle("unknown", &handle), ZELQO_ERROR_NO_DATA);
  EXPECT_EQ(handle, nullptr);
  EXPECT_EQ(zelqo_push_info_get_handle("", &handle), ZELQO_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(zelqo_upload_info_get_handle(999, &handle), ZELQO_ERROR_NO_DATA);
  EXPECT_EQ(zelqo_upload_info_get_handle(-1, &handle), ZELQO_ERROR_NO_DATA);
}

TEST_F(ShareInfo, SeesNewDataThroughTheSameHandle) {
  _store.addReceived(receivedShare("renewed"));
  const zelqo_share_h first = received("renewed");
  zelqo::ReceivedShare share = receivedShare("renewed");
  share.files.resize(1);
  share.files[0].name = "new.jpg";
  _store.addReceived(share);
  const zelqo_share_h second = received("renewed");
  EXPECT_EQ(first, second);
  unsigned int count = 0;
  zelqo_push_info_get_content_info_count(second, &count);
  EXPECT_EQ(count, 1U);
  EXPECT_EQ(text(zelqo_content_info_get_file_name, second, 0), "new.jpg");
}

TEST_F(ShareInfo, KeepsTheSendersTextForGood) {
  _store.addReceived(receivedShare("stable"));
  char* sender = nullptr;
  zelqo_push_info_get_sender_msisdn(received("stable"), &sender);
  for (int i = 0; i < 100; i++) received("stable");
  char* again = nullptr;
  zelqo_push_info_get_sender_msisdn(received("stable"), &again);
  EXPECT_EQ(sender, again);
  EXPECT_STREQ(sender, "+821011112222");
}

TEST_F(ShareInfo, StillAnswersForAShareThatWasOpenedEarlier) {
  _store.addReceived(receivedShare("earlier"));
  _store.addReceived(receivedShare("later"));
  const zelqo_share_h earlier = received("earlier");
  received("later");
  EXPECT_EQ(text(zelqo_content_info_get_file_name, earlier, 1), "b.txt");
}

TEST_F(ShareInfo, ShowsARecalledShareAsPast) {
  _store.addReceived(receivedShare("recalled"));
  const auto now = static_cast<unsigned long long>(g_get_real_time() / 1000);
  _store.markRecalled("recalled", static_cast<std::int64_t>(now));
  EXPECT_LT(end(received("recalled")) / 1000, now / 1000);
}

TEST_F(ShareInfo, ShowsAnExpiredShareAtItsExpiryWhateverCameLater) {
  zelqo::ReceivedShare share = receivedShare("expired");
  share.expiresMs = 5000;
  _store.addReceived(share);
  _store.markRecalled("expired", 900000);
  EXPECT_EQ(end(received("expired")), 5000U);
}

TEST_F(ShareInfo, ShowsTheLargestSizeForALargerOne) {
  zelqo::ReceivedShare share = receivedShare("large");
  share.files[0].size = 0x100000000;
  _store.addReceived(share);
  unsigned int size = 0;
  zelqo_content_info_get_file_size(received("large"), 0, &size);
  EXPECT_EQ(size, 0xffffffffU);
}

TEST_F(ShareInfo, OpensTenThousandFiles) {
  zelqo::ReceivedShare share = receivedShare("many");
  share.files.assign(10000, share.files[0]);
  _store.addReceived(share);
  const zelqo_share_h handle = received("many");
  unsigned int count = 0;
  zelqo_push_info_get_content_info_count(handle, &count);
  EXPECT_EQ(count, 10000U);
  EXPECT_EQ(text(zelqo_content_info_get_file_name, handle, 9999), "a.jpg");
}

TEST_F(ShareInfo, AnswersForASentShare) {
  _store.addSent(sentShare(7, "sent"));
  zelqo_share_h handle = nullptr;
  ASSERT_EQ(zelqo_upload_info_get_handle(7, &handle), 0);
  zelqo_recipient_s** list = nullptr;
  unsigned int count = 0;
  ASSERT_EQ(zelqo_upload_info_get_recipient_msisdn_list(handle, &list, &count), 0);
  ASSERT_EQ(count, 2U);
  EXPECT_STREQ(list[0]->msisdn, "+821099998888");
  EXPECT_STREQ(list[1]->msisdn, "+821077776666");
  EXPECT_EQ(list[1]->index, 1U);
  EXPECT_EQ(zelqo_upload_info_get_content_info_count(handle, &count), 0);
  EXPECT_EQ(count, 2U);
  char* path = nullptr;
  EXPECT_EQ(zelqo_upload_info_get_content_file_path(handle, 1, &path), 0);
  EXPECT_EQ(taken(path), "/opt/usr/media/b.txt");
  EXPECT_NE(zelqo_upload_info_get_content_file_path(handle, 2, &path), 0);
  EXPECT_EQ(path, nullptr);
}

TEST_F(ShareInfo, KeepsARecipientListThatWasGiven) {
  _store.addSent(sentShare(8, "given"));
  zelqo_share_h handle = nullptr;
  zelqo_upload_info_get_handle(8, &handle);
  zelqo_recipient_s** before = nullptr;
  unsigned int count = 0;
  zelqo_upload_info_get_recipient_msisdn_list(handle, &before, &count);
  zelqo::SentShare changed = sentShare(8, "given");
  changed.recipients = {"+821055554444"};
  _store.addSent(changed);
  zelqo_upload_info_get_handle(8, &handle);
  zelqo_recipient_s** after = nullptr;
  zelqo_upload_info_get_recipient_msisdn_list(handle, &after, &count);
  EXPECT_EQ(count, 1U);
  EXPECT_STREQ(after[0]->msisdn, "+821055554444");
  EXPECT_STREQ(before[1]->msisdn, "+821077776666");
}

TEST_F(ShareInfo, GivesNoRecipientsWhereThereAreNone) {
  zelqo::SentShare share = sentShare(9, "none");
  share.recipients.clear();
  share.paths.clear();
  _store.addSent(share);
  zelqo_share_h handle = nullptr;
  ASSERT_EQ(zelqo_upload_info_get_handle(9, &handle), 0);
  zelqo_recipient_s** list = nullptr;
  unsigned int count = 1;
  EXPECT_EQ(zelqo_upload_info_get_recipient_msisdn_list(handle, &list, &count), 0);
  EXPECT_EQ(count, 0U);
  EXPECT_NE(zelqo_upload_info_get_recipient_msisdn_list(nullptr, &list, &count), 0);
  EXPECT_EQ(list, nullptr);
}

}  // namespace
