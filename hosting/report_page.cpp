#include "hosting/report_page.h"

#include "framework/support/html_text.h"

namespace frontpanels {
namespace {

constexpr std::string_view kHead = R"(<!DOCTYPE html>
<html lang="en">
<head>
<meta charset="utf-8">
<meta http-equiv="Content-Security-Policy" content="default-src 'none'; img-src data:; style-src 'unsafe-inline'">
<meta name="viewport" content="width=device-width">
<title>)";

constexpr std::string_view kStyle = R"(</title>
<style>
body { font-family: sans-serif; max-width: 60em; margin: 2em auto; padding: 0 1em; color: #000; background: #fff; }
table { border-collapse: collapse; margin: 1em 0; }
th, td { border: 1px solid #999; padding: 0.2em 0.6em; text-align: left; }
img { max-width: 100%; height: auto; }
@page { margin: 15mm; }
@media print {
  body { max-width: none; margin: 0; padding: 0; }
  section { break-before: page; }
  section:first-of-type { break-before: auto; }
  tr, img { break-inside: avoid; }
  h1, h2 { break-after: avoid; }
}
</style>
</head>
<body>
)";

constexpr std::string_view kUntitled = "Report";

std::string element(std::string_view tag, std::string_view text) {
  const std::string name(tag);
  return "<" + name + ">" + htmlEscaped(text) + "</" + name + ">\n";
}

}  // namespace

std::string reportPage(std::string_view title, std::string_view stamp, std::span<const ReportPart> parts) {
  if (title.empty()) title = kUntitled;  // a page must have one
  std::string page(kHead);
  page.append(htmlEscaped(title)).append(kStyle).append(element("h1", title));
  if (!stamp.empty()) page += element("p", stamp);
  for (const ReportPart& part : parts) {
    page += "<section>\n";
    if (!part.title.empty()) page += element("h2", part.title);
    page.append(part.html).append("</section>\n");
  }
  return page + "</body>\n</html>\n";
}

}  // namespace frontpanels
