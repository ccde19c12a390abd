#include "hosting/report_page.h"

#include <gtest/gtest.h>

namespace frontpanels {
namespace {

// Behind the style sheet, which tests leave to the eye.
std::string bodyOf(const std::string& page) { return page.substr(page.find("<body>")); }

TEST(ReportPageTest, IsOnePageOfAllParts) {
  const ReportPart parts[] = {{"Spectrum", "<div>1</div>\n"}, {"", "<div>2</div>\n"}};
  const std::string page = reportPage("Drive 7", "2024-05-01 13:30", parts);
  EXPECT_EQ(page.rfind("<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n", 0), 0U);
  EXPECT_NE(page.find("<title>Drive 7</title>"), std::string::npos);
  EXPECT_EQ(bodyOf(page),
            "<body>\n<h1>Drive 7</h1>\n<p>2024-05-01 13:30</p>\n"
            "<section>\n<h2>Spectrum</h2>\n<div>1</div>\n</section>\n"
            "<section>\n<div>2</div>\n</section>\n</body>\n</html>\n");
}

TEST(ReportPageTest, TextsAreNoMarkupAndHoldNothingThatNoPageMay) {
  const ReportPart parts[] = {{"a & b", ""}};
  // U+FFFD stands for a zero, for the control characters U+001B and U+0085 and for a byte that is no UTF-8.
  const std::string page =
      reportPage("</title><script>", std::string("\"x\" \0\x1b\xC2\x85\xFF \u00E4", 12), parts);
  EXPECT_NE(page.find("<title>&lt;/title&gt;&lt;script&gt;</title>"), std::string::npos);
  EXPECT_EQ(bodyOf(page),
            "<body>\n<h1>&lt;/title&gt;&lt;script&gt;</h1>\n"
            "<p>&quot;x&quot; \uFFFD\uFFFD\uFFFD\uFFFD \u00E4</p>\n"
            "<section>\n<h2>a &amp; b</h2>\n</section>\n</body>\n</html>\n");
}

TEST(ReportPageTest, HasATitleWhateverIsGiven) {
  const std::string page = reportPage("", "", {});
  EXPECT_NE(page.find("<title>Report</title>"), std::string::npos);
  EXPECT_EQ(bodyOf(page), "<body>\n<h1>Report</h1>\n</body>\n</html>\n");
}

}  // namespace
}  // namespace frontpanels
