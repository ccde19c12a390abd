#include "framework/support/error_handler.h"

#include <gtest/gtest.h>

#include <new>
#include <stdexcept>

#include "framework/support/guard.h"
#include "platform/runtime_error.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {
namespace {

using Messages = std::vector<std::string>;

class ErrorHandlerTest : public ReportingTest {};

TEST_F(ErrorHandlerTest, ReportsShowTheMessageAloneOfThreeArgumentsTheSecond) {
  errorHandler().ModalReportError("first", "second", "third");
  errorHandler().ReportError("QUILL_VFP_CLOSE failed");
  EXPECT_EQ(messages(), (Messages{"second", "QUILL_VFP_CLOSE failed"}));
}

TEST_F(ErrorHandlerTest, AssertAppendsACarriageReturnAndTheCurrentDescription) {
  errorHandler().Assert("clsBaseVFP::nothing went wrong", "a source");
  guard("clsBaseVFP::vfpSet() ... ", [] { raiseOverflow(); });
  errorHandler().Assert("and afterwards");
  EXPECT_EQ(messages(), (Messages{"clsBaseVFP::nothing went wrong\r", "clsBaseVFP::vfpSet() ... \rOverflow",
                                  "and afterwards\r"}));
}

TEST_F(ErrorHandlerTest, TheSwitchSilencesAssertAndNothingElse) {
  reporting().silenceAssert = true;
  errorHandler().Assert("unheard");
  EXPECT_FALSE(guard("unheard", [] { raiseOverflow(); }));
  errorHandler().ReportError("one");
  errorHandler().ModalReportError("", "two", "");
  EXPECT_EQ(messages(), (Messages{"one", "two"}));
  EXPECT_EQ(messageLog().count(), 2U);
}

TEST_F(ErrorHandlerTest, WithoutBoxesOrDialogsMessagesReachTheLogAlone) {
  reporting().showMessages = false;
  errorHandler().ReportError("one");
  reporting() = Reporting{};
  errorHandler().ReportError("two");
  EXPECT_EQ(messages(), Messages{});
  EXPECT_EQ(messageLog().messages(), (std::deque<std::string>{"one", "two"}));
}

TEST_F(ErrorHandlerTest, TheLogKeepsTheLatestThousandAndCountsAll) {
  for (int i = 1; i <= 1002; ++i) messageLog().add(std::to_string(i));
  EXPECT_EQ(messageLog().messages().size(), 1000U);
  EXPECT_EQ(messageLog().messages().front(), "3");
  EXPECT_EQ(messageLog().messages().back(), "1002");
  EXPECT_EQ(messageLog().count(), 1002U);
  messageLog().clear();
  EXPECT_EQ(messageLog().count(), 0U);
  EXPECT_TRUE(messageLog().messages().empty());
}

TEST_F(ErrorHandlerTest, NothingGetsPastAGuard) {
  EXPECT_TRUE(guard("unused", [] {}));
  EXPECT_FALSE(guard("paint ... ", [] { throw std::bad_alloc(); }));
  EXPECT_FALSE(guard("paint ... ", [] { throw std::runtime_error("inner words"); }));
  EXPECT_FALSE(guard("paint ... ", [] { throw 5; }));
  EXPECT_EQ(guarded("index ... ", -1, []() -> int { raiseSubscriptOutOfRange(); }), -1);
  EXPECT_EQ(guarded("unused", -1, [] { return 7; }), 7);
  EXPECT_EQ(messages(), (Messages{"paint ... \rOut of memory", "paint ... \rInternal error",
                                  "paint ... \rInternal error", "index ... \rSubscript out of range"}));
}

TEST_F(ErrorHandlerTest, AMessageWithAValueIsMadeOnlyForAFailureAndMayFailItself) {
  int made = 0;
  const auto message = [&made] { return "value " + std::to_string(++made) + " ... "; };
  EXPECT_TRUE(guard(message, [] {}));
  EXPECT_EQ(made, 0);
  EXPECT_FALSE(guard(message, [] { raiseTypeMismatch(); }));
  EXPECT_FALSE(guard([]() -> std::string { throw std::bad_alloc(); }, [] { raiseTypeMismatch(); }));
  EXPECT_EQ(messages(), (Messages{"value 1 ... \rType mismatch", "\rOut of memory"}));
}

TEST_F(ErrorHandlerTest, AGuardInsideAGuardReportsForItself) {
  guard("outer ... ", [] {
    guard("inner ... ", [] { raiseTypeMismatch(); });
    errorHandler().Assert("between");
    raiseOverflow();
  });
  EXPECT_EQ(messages(), (Messages{"inner ... \rType mismatch", "between\r", "outer ... \rOverflow"}));
}

}  // namespace
}  // namespace frontpanels::testing
