#include "ZQVTicket.h"

#include <gtest/gtest.h>

TEST(Ticket, FindsItsHolder) {
  int holder = 0;
  const ZQVTicket ticket(&holder);
  EXPECT_EQ(ZQVTicket::holderOf(ticket.asUserData()), &holder);
}

TEST(Ticket, FindsNobodyOnceItIsGoneEvenForANewHolderAtTheSamePlace) {
  int holder = 0;
  void* data = nullptr;
  {
    const ZQVTicket ticket(&holder);
    data = ticket.asUserData();
  }
  const ZQVTicket next(&holder);
  EXPECT_EQ(ZQVTicket::holderOf(data), nullptr);
}

TEST(Ticket, FindsNobodyAfterItWasWithdrawn) {
  int holder = 0;
  ZQVTicket ticket(&holder);
  ticket.withdraw();
  ticket.withdraw();
  EXPECT_EQ(ZQVTicket::holderOf(ticket.asUserData()), nullptr);
}

TEST(Ticket, NullFindsNobody) {
  EXPECT_EQ(ZQVTicket::holderOf(nullptr), nullptr);
}
