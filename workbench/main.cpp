// workbench.exe: command line, COM, and the barrier round it all.
#include <windows.h>

#include <ole2.h>
#include <shellapi.h>

#include <memory>
#include <string>
#include <vector>

#include "platform/textfile.h"
#include "platform/win32/utf16.h"
#include "workbench/console.h"
#include "workbench/failure.h"
#include "workbench/options.h"
#include "workbench/workbench.h"

namespace frontpanels::workbench {
namespace {

class OleScope {
 public:
  OleScope() { check(OleInitialize(nullptr), "Starting OLE"); }
  OleScope(const OleScope&) = delete;
  OleScope& operator=(const OleScope&) = delete;
  ~OleScope() { OleUninitialize(); }
};

std::vector<std::string> commandLine() {
  int count = 0;
  struct Free {
    void operator()(LPWSTR* memory) const noexcept { LocalFree(memory); }
  };
  const std::unique_ptr<LPWSTR, Free> words(CommandLineToArgvW(GetCommandLineW(), &count));
  std::vector<std::string> arguments;
  for (int i = 1; i < count; ++i) arguments.push_back(toUtf8(words.get()[i]));
  return arguments;
}

bool isUnattended(const std::vector<std::string>& arguments) {
  return std::find(arguments.begin(), arguments.end(), "--exit") != arguments.end();
}

void tell(bool unattended, const std::string& text, UINT icon) {
  writeError(text);
  if (!unattended) MessageBoxW(nullptr, toUtf16(text).c_str(), L"Front Panels workbench", MB_OK | icon);
}

ExitCode runProgram(const std::vector<std::string>& arguments, int showCommand) {
  const Options options = parseOptions(arguments);
  if (options.help) {
    tell(options.exit, kUsage, MB_ICONINFORMATION);
    return ExitCode::Done;
  }
  const OleScope ole;
  Workbench workbench(options, systemTextFiles());
  return workbench.run(showCommand);
}

ExitCode guardedRun(int showCommand) noexcept {
  bool unattended = true;
  try {
    const std::vector<std::string> arguments = commandLine();
    unattended = isUnattended(arguments);
    try {
      return runProgram(arguments, showCommand);
    } catch (const UsageError& error) {
      tell(unattended, std::string(error.what()) + "\n\n" + kUsage, MB_ICONWARNING);
      return ExitCode::Usage;
    } catch (...) {
      tell(unattended, currentFailure(), MB_ICONERROR);
      return ExitCode::Failed;
    }
  } catch (...) {
    return ExitCode::Failed;
  }
}

}  // namespace
}  // namespace frontpanels::workbench

int WINAPI WinMain(HINSTANCE, HINSTANCE, LPSTR, int showCommand) {
  return static_cast<int>(frontpanels::workbench::guardedRun(showCommand));
}
