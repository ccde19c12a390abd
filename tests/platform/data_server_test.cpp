#include "platform/data_server.h"

#include <gtest/gtest.h>

#include <array>
#include <stdexcept>
#include <utility>

#include "tests/support/raised.h"

namespace frontpanels {
namespace {

using Log = std::vector<std::string>;

class DataServerTest : public ::testing::Test {
 protected:
  // A server that writes its name, the path's index and the path's first value into the log.
  std::unique_ptr<DataServer> listen(const std::string& name, std::string_view paths) {
    auto server = std::make_unique<DataServer>(hub, [this, name](std::int32_t index) {
      log.push_back(name + std::to_string(index) + "=" + servers.at(name)->value(index, 0).toText());
      if (const auto found = onEvent.find(name); found != onEvent.end()) {
        const auto once = std::exchange(found->second, [] {});
        once();
      }
    });
    servers[name] = server.get();
    server->subscribe(paths);
    return server;
  }

  DataHub hub;
  Log log;
  std::map<std::string, DataServer*> servers;
  std::map<std::string, std::function<void()>> onEvent;  // what a server does inside its first event
};

TEST_F(DataServerTest, TellsEverySubscriberTheIndexOfThePathInItsOwnList) {
  const auto a = listen("a", "Noise\x1bTrace");
  const auto b = listen("b", "Trace");
  hub.publish("Trace", Variant(1.5));
  hub.publish("Noise", Variant("quiet"));
  hub.publish("Nobody's", Variant(3.0));
  EXPECT_EQ(log, (Log{"a1=1.5", "b0=1.5", "a0=quiet"}));
}

TEST_F(DataServerTest, SubscribingReplacesWhatWasSubscribedBefore) {
  const auto a = listen("a", "Old\x1b\x1bTwice\x1bTwice");
  hub.publish("Twice", Variant(1.0));
  a->subscribe("New");
  hub.publish("Old", Variant(2.0));
  hub.publish("New", Variant(3.0));
  a->subscribe("");
  hub.publish("New", Variant(4.0));
  EXPECT_EQ(log, (Log{"a2=1", "a3=1", "a0=3"}));
  EXPECT_EQ(testing::raised([&] { return a->itemCount(0); }), "Subscript out of range");
}

TEST_F(DataServerTest, AnswersCountsAndValuesOfScalarsAndArrays) {
  const auto a = listen("a", "Scalar\x1bList\x1bSilent");
  hub.publish("Scalar", Variant(std::int16_t{7}));
  hub.publish("List", Variant(Variant::Doubles{0.25, 1e39}));
  EXPECT_EQ(a->itemCount(0), 1);
  EXPECT_EQ(a->itemCount(1), 2);
  EXPECT_EQ(a->itemCount(2), 0);
  EXPECT_EQ(hub.itemCount("Never seen"), 0);
  EXPECT_EQ(a->value(0, 0), Variant(std::int16_t{7}));
  EXPECT_EQ(hub.value("List", 1), Variant(1e39));
  EXPECT_EQ(a->singleValue(1, 0), 0.25F);
  EXPECT_TRUE(a->singles(1).empty());  // doubles are no singles
}

TEST_F(DataServerTest, RaisesForWhatIsNotThere) {
  const auto a = listen("a", "Trace");
  hub.publish("Trace", std::array{1.0F, 2.0F});
  hub.publish("Scalar", Variant(1.0));
  const std::function<void()> calls[] = {
      [&] { static_cast<void>(a->value(0, 2)); },        [&] { static_cast<void>(a->singleValue(0, -1)); },
      [&] { static_cast<void>(a->itemCount(1)); },       [&] { static_cast<void>(a->singles(-1)); },
      [&] { static_cast<void>(hub.value("Other", 0)); }, [&] { static_cast<void>(hub.value("Scalar", -1)); }};
  for (const auto& call : calls) EXPECT_EQ(testing::raised(call), "Subscript out of range");
}

TEST_F(DataServerTest, ReadsAWholeSweepAtOnceFromABufferThatIsReused) {
  DataServer a(hub, [](std::int32_t) {});
  a.subscribe("Trace");
  hub.publish("Trace", std::array{1.0F, 2.0F, 3.0F});
  const float* buffer = a.singles(0).data();
  hub.publish("Trace", std::array{4.0F, 5.0F});
  EXPECT_EQ(a.singles(0).data(), buffer);
  EXPECT_EQ(std::vector<float>(a.singles(0).begin(), a.singles(0).end()), (std::vector<float>{4, 5}));
  EXPECT_EQ(a.singleValue(0, 1), 5.0F);
  hub.publish("Trace", Variant());  // taken back
  EXPECT_EQ(hub.itemCount("Trace"), 0);
}

TEST_F(DataServerTest, APublicationInsideAnEventOfItsPathComesAfterTheCurrentOne) {
  const auto a = listen("a", "Trace");
  const auto b = listen("b", "Trace\x1bOther");
  onEvent["a"] = [this] {
    hub.publish("Trace", std::array{2.0F});
    hub.publish("Trace", Variant(3.0));
    hub.publish("Other", Variant(9.0));  // another path: at once
  };
  hub.publish("Trace", std::array{1.0F});
  hub.publish("Trace", Variant(4.0));
  EXPECT_EQ(log, (Log{"a0=1", "b1=9", "b0=1", "a0=2", "b0=2", "a0=3", "b0=3", "a0=4", "b0=4"}));
}

TEST_F(DataServerTest, ServersMayComeAndGoInsideAnEvent) {
  auto a = listen("a", "Trace");
  auto b = listen("b", "Trace");
  const auto c = listen("c", "Trace");
  std::unique_ptr<DataServer> late;
  onEvent["a"] = [&] {
    b.reset();                       // goes before it has heard
    late = listen("late", "Trace");  // hears the next event
    a.reset();                       // goes inside its own event
  };
  hub.publish("Trace", Variant(1.0));
  hub.publish("Trace", Variant(2.0));
  EXPECT_EQ(log, (Log{"a0=1", "c0=1", "c0=2", "late0=2"}));
}

TEST_F(DataServerTest, AServerThatSubscribesAgainInsideItsEventHearsEachEventOnce) {
  const auto a = listen("a", "Trace");
  const auto b = listen("b", "Trace");
  onEvent["a"] = [&] { a->subscribe("Other\x1bTrace"); };
  hub.publish("Trace", Variant(1.0));
  hub.publish("Trace", Variant(2.0));
  EXPECT_EQ(log, (Log{"a0=1", "b0=1", "b0=2", "a1=2"}));
}

TEST_F(DataServerTest, AHandlerThatThrowsKeepsTheEventFromNobody) {
  const auto a = listen("a", "Trace");
  const auto b = listen("b", "Trace");
  onEvent["a"] = [] { throw std::runtime_error("a failed"); };
  EXPECT_THROW(hub.publish("Trace", Variant(1.0)), std::runtime_error);
  hub.publish("Trace", Variant(2.0));
  EXPECT_EQ(log, (Log{"a0=1", "b0=1", "a0=2", "b0=2"}));
}

}  // namespace
}  // namespace frontpanels
