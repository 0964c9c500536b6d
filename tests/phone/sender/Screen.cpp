#include "Screen.h"

#include <libsoup/soup.h>

using phone::Phone;
using phone::Share;
using phone::thePhone;
using phone::waitFor;
using phone::Widget;
using phone::Words;

testing::AssertionResult shows(const Phone& phone, std::size_t cells) {
  const auto count = [&] {
    std::size_t found = 0;
    for (const Widget& item : phone.tree().items()) {
      found += item.name.find("on this phone") != std::string::npos;
    }
    return found;
  };
  return seen(phone, waitFor([&] { return count() == cells; }),
              "not " + std::to_string(cells) + " cells");
}

testing::AssertionResult viewerEnds(const Phone& phone) {
  return seen(phone, waitFor([&] { return phone.processesOf({"zelqo-viewer"}).empty(); }),
              "the viewer runs");
}

Words linesWith(const Phone& phone, const std::string& command, const std::string& text) {
  Words found;
  for (const std::string& line : phone.lines(command)) {
    if (line.find(text) != std::string::npos) found.push_back(line);
  }
  return found;
}

void openApplication(const Phone& phone, const char* application) {
  phone({"launch", "raw", "default", "--app", application});
}

void openSent(const Phone& phone, const Share& share) {
  phone({"launch", "sent", "--request", std::to_string(share.request)});
}

std::string serviceOf(const Phone& phone) {
  const std::string status = phone({"status"});
  const std::size_t begin = status.find("http://");
  return status.substr(begin, status.find('\n', begin) - begin);
}

std::unique_ptr<Phone> secondPhone(const Phone& first) {
  return std::make_unique<Phone>("phone_sender_test_2",
                                 Words{"--number", kSecondNumber, "--service", serviceOf(first)});
}

unsigned statusOf(const Phone& phone, const Share& share, int file) {
  const std::string address =
      serviceOf(phone) + "/share/" + share.token + "/file/" + std::to_string(file);
  SoupSession* session = soup_session_new();
  SoupMessage* message = soup_message_new("GET", address.c_str());
  GBytes* body = soup_session_send_and_read(session, message, nullptr, nullptr);
  const unsigned status = soup_message_get_status(message);
  if (body) g_bytes_unref(body);
  g_object_unref(message);
  g_object_unref(session);
  return status;
}

void Sending::SetUp() {
  _loggedBefore = thePhone().log().size();
}

testing::AssertionResult Sending::logs(const std::string& text) const {
  if (waitFor([&] { return thePhone().log().find(text, _loggedBefore) != std::string::npos; })) {
    return testing::AssertionSuccess();
  }
  return testing::AssertionFailure() << "not logged: " << text;
}

void Sending::TearDown() {
  const Phone& phone = thePhone();
  phone({"service", "ok"});
  phone({"account", "on"});
  phone.closeViewer();
}

Share Sending::send(const Words& names, const std::string& to) {
  Words files;
  for (const std::string& name : names) files.push_back(thePhone().makeFile(name));
  return thePhone().shareTo(to, kOwnNumber, files);
}
