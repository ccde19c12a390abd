#include "framework/support/error_handler.h"

#include <gtest/gtest.h>

#include <new>
#include <stdexcept>

#include "framework/support/guard.h"
#include "platform/runtime_error.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {
namespace {

class ErrorHandlerTest : public ReportingTest {};

TEST_F(ErrorHandlerTest, ReportsShowTheMessageAloneAndAssertAddsTheCurrentDescription) {
  errorHandler().ModalReportError("first", "second", "third");
  errorHandler().ReportError("QUILL_VFP_CLOSE failed");
  errorHandler().Assert("clsBaseVFP::nothing went wrong", "a source");
  guard("clsBaseVFP::vfpSet() ... ", [] { raiseOverflow(); });
  errorHandler().Assert("and afterwards");
  EXPECT_EQ(said(),
            "second\nQUILL_VFP_CLOSE failed\nclsBaseVFP::nothing went wrong\r\n"
            "clsBaseVFP::vfpSet() ... \rOverflow\nand afterwards\r");
}

TEST_F(ErrorHandlerTest, TheSwitchSilencesAssertAndNothingElse) {
  reporting().silenceAssert = true;
  errorHandler().Assert("unheard");
  EXPECT_FALSE(guard("unheard", [] { raiseOverflow(); }));
  errorHandler().ReportError("one");
  errorHandler().ModalReportError("", "two", "");
  EXPECT_EQ(messageLog().count(), 2U);
  EXPECT_EQ(said(), "one\ntwo");
}

TEST_F(ErrorHandlerTest, WithoutBoxesOrDialogsMessagesReachTheLogWhichKeepsTheLatestThousandAndCountsAll) {
  reporting().showMessages = false;
  errorHandler().ReportError("one");
  reporting() = Reporting{};
  errorHandler().ReportError("two");
  EXPECT_TRUE(messages().empty());
  EXPECT_EQ(messageLog().messages(), (std::deque<std::string>{"one", "two"}));
  for (int i = 3; i <= 1002; ++i) messageLog().add(std::to_string(i));
  EXPECT_EQ(messageLog().messages().size(), 1000U);
  EXPECT_EQ(messageLog().messages().front(), "3");
  EXPECT_EQ(messageLog().messages().back(), "1002");
  EXPECT_EQ(messageLog().count(), 1002U);
  messageLog().clear();
  EXPECT_EQ(messageLog().count(), 0U);
  EXPECT_TRUE(messageLog().messages().empty());
}

TEST_F(ErrorHandlerTest, NothingGetsPastAGuardWhichReportsForItself) {
  EXPECT_TRUE(guard("unused", [] {}));
  EXPECT_FALSE(guard("paint ... ", [] { throw std::bad_alloc(); }));
  EXPECT_FALSE(guard("paint ... ", [] { throw std::runtime_error("inner words"); }));
  EXPECT_FALSE(guard("paint ... ", [] { throw 5; }));
  EXPECT_EQ(guarded("index ... ", -1, []() -> int { raiseSubscriptOutOfRange(); }), -1);
  EXPECT_EQ(guarded("unused", -1, [] { return 7; }), 7);
  EXPECT_EQ(said(),
            "paint ... \rOut of memory\npaint ... \rInternal error\npaint ... \rInternal error\n"
            "index ... \rSubscript out of range");
  guard("outer ... ", [] {
    guard("inner ... ", [] { raiseTypeMismatch(); });
    errorHandler().Assert("between");
    raiseOverflow();
  });
  EXPECT_EQ(said(), "inner ... \rType mismatch\nbetween\r\nouter ... \rOverflow");
}

TEST_F(ErrorHandlerTest, AMessageWithAValueIsMadeOnlyForAFailureAndMayFailItself) {
  int made = 0;
  const auto message = [&made] { return "value " + std::to_string(++made) + " ... "; };
  EXPECT_TRUE(guard(message, [] {}));
  EXPECT_EQ(made, 0);
  EXPECT_FALSE(guard(message, [] { raiseTypeMismatch(); }));
  EXPECT_FALSE(guard([]() -> std::string { throw std::bad_alloc(); }, [] { raiseTypeMismatch(); }));
  EXPECT_EQ(said(), "value 1 ... \rType mismatch\n\rOut of memory");
}

}  // namespace
}  // namespace frontpanels::testing
