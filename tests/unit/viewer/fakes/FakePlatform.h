#pragma once

#include <zelqo.h>

#include <map>
#include <optional>
#include <string>
#include <vector>

using Text = std::optional<std::string>;

/// One file as the sharing service tells of it; an empty text is one that the service lacks.
struct FakeFile {
  Text name = "photo.jpg";
  Text type = "image/jpeg";
  unsigned int size = 1000;
  Text thumb;
  Text mid;
  Text big;
  Text url;
  Text path;
};

struct FakeShare {
  std::vector<FakeFile> files;
  Text sender = "+821011112222";
  unsigned long long expiry = 0;
  std::vector<std::string> recipients;
  int countError = 0;
  int expiryError = 0;
  int recipientsError = 0;
};

struct FakeContact {
  std::string number;
  Text name;
  Text image;
};

struct FakeDownload {
  std::vector<std::string> urls;
  std::string folder;
  int priority;
  int flags;
  zelqo_download_cb callback;
  void* userData;

  void arrive(const char* path, const char* url) const {
    callback(1, path ? 0 : -1, path, url, 0, userData);
  }
};

/// The phone's databases and services around the viewer: scripted, recorded, failing on demand.
/// Error members are what the call of that name answers; 0 means that it works.
struct FakePlatform {
  static FakePlatform& get();
  void reset();

  std::map<std::string, FakeShare> received;
  std::map<int, FakeShare> sent;
  std::vector<FakeDownload> downloads;
  int downloadError = 0;
  std::vector<unsigned int> askedUrls;  ///< service indices of the download addresses asked for

  std::map<std::string, std::string> preferences;

  std::vector<FakeContact> contacts;
  int contactsError = 0;
  int contactsConnectError = 0;
  std::vector<std::string> contactQueries;
  int openContactHandles = 0;

  /// Path to thumbnail; an empty text is a record without one.
  std::map<std::string, Text> media;
  std::vector<std::string> mediaConditions;
  int mediaConnectError = 0;
  int mediaDisconnectError = 0;
  int mediaFilterError = 0;
  int mediaConditionError = 0;
  int mediaForeachError = 0;
  int mediaThumbnailError = 0;
  int mediaConnections = 0;
  int openMediaHandles = 0;

  std::map<std::string, std::string> mimeTypes;

  int network = 1;
  int connectionCreateError = 0;
  int connectionTypeError = 0;
  int connectionsDestroyed = 0;
  std::vector<std::string> messages;

  Text regionFormat = "en_GB.UTF-8";
  std::string failingExtra;  ///< the launch extra that cannot be added
  int gridRefreshes = 0;

  long long now = 0;  ///< seconds since the epoch; 0 is the real time
  int exits = 0;
  int lowered = 0;
  int usageRecords = 0;
  std::map<int, std::pair<void (*)(int, void*), void*>> settingCallbacks;
  std::vector<int> watchedSettings;
  void (*contactsChanged)(const char*, void*) = nullptr;
  void* contactsChangedData = nullptr;

  /// What the file manager recorded, download address to path.
  std::map<std::string, std::string> recordedFiles;
  /// Stands for the phone's files: every path below /opt/usr that exists.
  std::map<std::string, long long> files;
  bool foldersCanBeMade = true;
  bool foldersAreWritable = true;
  int chmodError = 0;
  std::vector<std::string> madeFolders;
  std::vector<std::string> changedModes;
};
