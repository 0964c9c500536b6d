// What becomes of those who use a bus that does not answer, or goes.

#include <signal.h>

#include <chrono>

#include "TestPhone.h"

using base::BusKind;
using base::SignalSubscription;
using common::OwnedBus;
using common::OwnedVariant;

namespace {

using std::chrono::milliseconds;
using Clock = std::chrono::steady_clock;

constexpr const char* kBus = "org.freedesktop.DBus";
constexpr const char* kInterface = "test.Interface";
constexpr const char* kPath = "/test";

/// The bus takes messages and does nothing with them.
class Frozen {
 public:
  Frozen() { kill(TestPhone::bus(), SIGSTOP); }
  ~Frozen() { kill(TestPhone::bus(), SIGCONT); }
};

bool answers(GDBusConnection* bus) {
  const OwnedVariant answer =
      base::ask(bus, {kBus, "/org/freedesktop/DBus", kBus, "GetId", nullptr, "(s)"});
  return answer != nullptr;
}

milliseconds timeToAsk(GDBusConnection* bus) {
  const auto begin = Clock::now();
  EXPECT_FALSE(answers(bus));
  return std::chrono::duration_cast<milliseconds>(Clock::now() - begin);
}

void countCb(GDBusConnection*, const char*, const char*, const char*, const char*, GVariant*,
             void* count) {
  ++*static_cast<int*>(count);
}

void emit(GDBusConnection* bus, const char* member) {
  g_dbus_connection_emit_signal(bus, nullptr, kPath, kInterface, member, nullptr, nullptr);
  g_dbus_connection_flush_sync(bus, nullptr, nullptr);
}

}  // namespace

TEST(Bus, ThatIsSilentIsWaitedForOnce) {
  const OwnedBus bus = base::systemBus();
  ASSERT_TRUE(answers(bus.get()));
  {
    const Frozen frozen;
    EXPECT_GE(timeToAsk(bus.get()), base::kBusPatience);
    EXPECT_LT(timeToAsk(bus.get()), base::kBusPatience / 2);
  }
  EXPECT_TRUE(waitUntil([&] { return answers(bus.get()); }));
}

TEST(Bus, ThatIsSilentLetsSubscriptionsBeginAndEnd) {
  int count = 0;
  auto subscription = [&] {
    const Frozen frozen;
    return std::make_unique<SignalSubscription>(
        BusKind::System, SignalSubscription::Match{nullptr, kInterface, "Called", kPath}, countCb,
        &count);
  }();
  emit(otherConnection().get(), "Called");
  EXPECT_TRUE(waitUntil([&] { return count == 1; }));
  const Frozen frozen;
  subscription.reset();
}

TEST(Bus, ThatComesBackIsListenedToAgain) {
  int count = 0, returns = 0;
  const SignalSubscription subscription(BusKind::System, {nullptr, kInterface, "Called", kPath},
                                        countCb, &count);
  const base::BusReturn busReturn(BusKind::System, [&] { returns++; });
  TestPhone::replaceBus();
  ASSERT_TRUE(waitUntil([&] { return returns == 1; }));
  EXPECT_TRUE(answers(base::systemBus().get()));
  emit(otherConnection().get(), "Called");
  EXPECT_TRUE(waitUntil([&] { return count == 1; }));
  TestPhone::replaceBus();
  EXPECT_TRUE(waitUntil([&] { return returns == 2; }));
  emit(otherConnection().get(), "Called");
  EXPECT_TRUE(waitUntil([&] { return count == 2; }));
}

TEST(Bus, ReturnIsNoLongerToldToWhoHasGone) {
  int gone = 0, stays = 0;
  auto first = std::make_unique<base::BusReturn>(BusKind::System, [&] { gone++; });
  const base::BusReturn second(BusKind::System, [&] { stays++; });
  first.reset();
  TestPhone::replaceBus();
  EXPECT_TRUE(waitUntil([&] { return stays == 1; }));
  EXPECT_EQ(gone, 0);
}
