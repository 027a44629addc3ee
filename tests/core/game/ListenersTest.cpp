#include "core/game/Listeners.h"

#include <gmock/gmock.h>

#include <optional>
#include <string>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class Listening : public testing::Test {
 protected:
  Subscription Listen(const std::string& name) {
    return listeners.Listen([this, name](int message) { heard.push_back(name + std::to_string(message)); });
  }

  std::vector<std::string> heard;
  Listeners<int> listeners;
};

TEST_F(Listening, IsServedInTheOrderOfItsBeginning) {
  const Subscription c = Listen("c");
  const Subscription a = Listen("a");
  const Subscription b = Listen("b");
  listeners.Tell(1);
  listeners.Tell(2);
  EXPECT_THAT(heard, ElementsAre("c1", "a1", "b1", "c2", "a2", "b2"));
}

TEST_F(Listening, EndsWithItsHandle) {
  const Subscription a = Listen("a");
  {
    const Subscription b = Listen("b");
    listeners.Tell(1);
  }
  listeners.Tell(2);
  EXPECT_THAT(heard, ElementsAre("a1", "b1", "a2"));
}

TEST_F(Listening, GoesOnWithAHandleThatWasMoved) {
  Subscription a = Listen("a");
  Subscription b = Listen("b");
  const Subscription kept = std::move(a);
  b = Listen("c");
  listeners.Tell(1);
  EXPECT_THAT(heard, ElementsAre("a1", "c1"));
}

TEST_F(Listening, MayEndTwiceAndAfterWhatItListensTo) {
  std::optional<Listeners<int>> shortLived(std::in_place);
  Subscription a = shortLived->Listen([](int) {});
  shortLived.reset();
  a.End();
  a.End();
  EXPECT_THAT(heard, IsEmpty());
}

TEST_F(Listening, MayEndItselfInTheMidstOfATelling) {
  Subscription own;
  const auto kept = std::make_shared<std::string>("held by the listener");
  own = listeners.Listen([this, &own, kept](int message) {
    own.End();
    heard.push_back(*kept + std::to_string(message));
    listeners.Tell(message + 1);  // no longer heard
  });
  const Subscription next = Listen("next");
  listeners.Tell(1);
  listeners.Tell(5);
  EXPECT_THAT(heard, ElementsAre("held by the listener1", "next2", "next1", "next5"));
  EXPECT_EQ(kept.use_count(), 1);
}

TEST_F(Listening, MayEndOfAnotherWhoIsNotServedYet) {
  Subscription last;
  const Subscription first = listeners.Listen([&last](int) { last.End(); });
  last = Listen("last");
  listeners.Tell(1);
  EXPECT_THAT(heard, IsEmpty());
}

TEST_F(Listening, MayEndOfAnotherWhoWasServedAlready) {
  Subscription first = Listen("first");
  const Subscription second = listeners.Listen([&first](int) { first.End(); });
  const Subscription third = Listen("third");
  listeners.Tell(1);
  listeners.Tell(2);
  EXPECT_THAT(heard, ElementsAre("first1", "third1", "third2"));
}

TEST_F(Listening, BegunInTheMidstOfATellingHearsTheNext) {
  std::vector<Subscription> added;
  const Subscription first = listeners.Listen([&](int message) {
    if (message <= 2) {
      added.push_back(Listen("added" + std::to_string(message) + ":"));
    }
  });
  listeners.Tell(1);
  EXPECT_THAT(heard, IsEmpty());
  listeners.Tell(2);
  listeners.Tell(3);
  EXPECT_THAT(heard, ElementsAre("added1:2", "added1:3", "added2:3"));
}

TEST_F(Listening, HearsWhatIsToldInTheMidstOfATelling) {
  const Subscription first = listeners.Listen([this](int message) {
    if (message == 1) {
      listeners.Tell(2);
    }
  });
  const Subscription second = Listen("b");
  listeners.Tell(1);
  EXPECT_THAT(heard, ElementsAre("b2", "b1"));
}

}  // namespace
