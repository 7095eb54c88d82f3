#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <stdexcept>

#include "support/tarsel/TraceRecorder.h"
#include "tarsel/Console.h"
#include "tarsel/ConsoleLogFile.h"
#include "tarsel/ThrowError.h"

using namespace tarsel::console;
namespace fs = std::filesystem;

namespace {

std::string Utf8(const UTF16String& s) { return tarsel::utility::ToStdString(tarsel::utility::UTF16to8(s)); }

// Records each line it was run with, as "name|arg1|arg2|...|<argument text>".
class RecordingCommand : public Command {
 public:
  explicit RecordingCommand(std::vector<std::string>& outRuns) : mRuns(outRuns) {}
  void Execute(const CommandLine& inLine, std::ostream& outStream) override {
    std::string run = Utf8(inLine.mName);
    for (const UTF16String& arg : inLine.mArguments) run += "|" + Utf8(arg);
    run += "|<" + Utf8(inLine.mArgumentText) + ">";
    mRuns.push_back(run);
    outStream << "ran " << Utf8(inLine.mName) << '\n';
  }

 private:
  std::vector<std::string>& mRuns;
};

class LambdaCommand : public Command {
 public:
  explicit LambdaCommand(std::function<void(const CommandLine&, std::ostream&)> inBody) : mBody(std::move(inBody)) {}
  void Execute(const CommandLine& inLine, std::ostream& outStream) override { mBody(inLine, outStream); }

 private:
  std::function<void(const CommandLine&, std::ostream&)> mBody;
};

CommandFactory Lambda(std::function<void(const CommandLine&, std::ostream&)> inBody) {
  return [inBody] { return std::make_unique<LambdaCommand>(inBody); };
}

class ConsoleTest : public ::testing::Test {
 protected:
  void SetUp() override { CommandRegistry::UnregisterAll(); }
  void TearDown() override { CommandRegistry::UnregisterAll(); }

  void RegisterRecorder(const char16_t* inName, const char16_t* inHelp = u"") {
    CommandRegistry::RegisterCommand(inName, inHelp,
                                     [this] { return std::make_unique<RecordingCommand>(mRuns); });
  }

  std::vector<std::string> mRuns;
  std::ostringstream mOut;
};

}  // namespace

TEST_F(ConsoleTest, ARegisteredCommandRunsWithItsArgumentsAndWritesToTheStream) {
  RegisterRecorder(u"con.echo");
  EXPECT_TRUE(ExecuteCommand(u"  con.echo   on\t extra  ", mOut));
  EXPECT_EQ(mRuns, (std::vector<std::string>{"con.echo|on|extra|<on\t extra>"}));
  EXPECT_EQ(mOut.str(), "ran con.echo\n");
}

TEST_F(ConsoleTest, AnUnknownCommandAnswersFalseAndABlankLineRunsNothingWithoutAnError) {
  RegisterRecorder(u"con.help");
  EXPECT_FALSE(ExecuteCommand(u"con.nothing here", mOut));
  EXPECT_TRUE(ExecuteCommand(u"   \t ", mOut));
  EXPECT_TRUE(ExecuteCommand(u"", mOut));
  EXPECT_TRUE(mRuns.empty());
  EXPECT_TRUE(mOut.str().empty());
}

TEST_F(ConsoleTest, CommandNamesMatchWithoutRegardToCaseAndRegisteringANameAgainReplacesTheCommand) {
  int first = 0, second = 0;
  CommandRegistry::RegisterCommand(u"con.Clear", u"", Lambda([&](const CommandLine&, std::ostream&) { ++first; }));
  CommandRegistry::RegisterCommand(u"CON.clear", u"", Lambda([&](const CommandLine&, std::ostream&) { ++second; }));
  EXPECT_TRUE(ExecuteCommand(u"CON.CLEAR", mOut));
  EXPECT_EQ(first, 0);
  EXPECT_EQ(second, 1);
  EXPECT_EQ(CommandRegistry::GetCommandNames().size(), 1u);
  EXPECT_TRUE(CommandRegistry::UnregisterCommand(u"Con.Clear"));
  EXPECT_FALSE(CommandRegistry::UnregisterCommand(u"con.clear"));
}

TEST_F(ConsoleTest, QuotesKeepBlanksInsideOneArgument) {
  RegisterRecorder(u"con.run");
  ExecuteCommand(u"con.run \"/tmp/my batch.txt\" fast \"\"", mOut);
  EXPECT_EQ(mRuns, (std::vector<std::string>{"con.run|/tmp/my batch.txt|fast||<\"/tmp/my batch.txt\" fast \"\">"}));
  CommandLine unclosed = ParseCommandLine(u"x \"open ended");
  ASSERT_EQ(unclosed.mArguments.size(), 1u);
  EXPECT_EQ(Utf8(unclosed.mArguments[0]), "open ended");
}

TEST_F(ConsoleTest, ListingGivesEachHelpTextSortedByNameOrTheNameWithoutHelp) {
  RegisterRecorder(u"con.help", u"con.help - Lists all installed commands.");
  RegisterRecorder(u"con.clear", u"con.clear - Clears the console output area.");
  RegisterRecorder(u"app.quiet");
  ListCommands(mOut);
  EXPECT_EQ(mOut.str(),
            "app.quiet\n"
            "con.clear - Clears the console output area.\n"
            "con.help - Lists all installed commands.\n");
}

TEST_F(ConsoleTest, AFactoryMakesAFreshCommandForEachRunAndASharedCommandKeepsItsState) {
  int made = 0;
  CommandRegistry::RegisterCommand(u"fresh", u"", [&] {
    ++made;
    return std::make_unique<LambdaCommand>([](const CommandLine&, std::ostream&) {});
  });
  struct Counter : Command {
    int runs = 0;
    void Execute(const CommandLine&, std::ostream&) override { ++runs; }
  };
  auto counter = std::make_shared<Counter>();
  CommandRegistry::RegisterCommand(u"shared", u"", std::shared_ptr<Command>(counter));
  for (int i = 0; i < 3; ++i) {
    ExecuteCommand(u"fresh", mOut);
    ExecuteCommand(u"shared", mOut);
  }
  EXPECT_EQ(made, 3);
  EXPECT_EQ(counter->runs, 3);
}

TEST_F(ConsoleTest, ACommandMayUnregisterItselfWhileRunning) {
  int runs = 0;
  CommandRegistry::RegisterCommand(u"once", u"", Lambda([&](const CommandLine&, std::ostream&) {
                                     ++runs;
                                     CommandRegistry::UnregisterCommand(u"once");
                                   }));
  EXPECT_TRUE(ExecuteCommand(u"once", mOut));
  EXPECT_FALSE(ExecuteCommand(u"once", mOut));
  EXPECT_EQ(runs, 1);
}

TEST_F(ConsoleTest, ASharedCommandSurvivesUnregisteringItselfWhileRunning) {
  struct SelfRemover : Command {
    bool finished = false;
    void Execute(const CommandLine&, std::ostream&) override {
      CommandRegistry::UnregisterCommand(u"self");
      finished = true;  // still alive: the registry's copy was not the last reference
    }
  };
  auto* raw = new SelfRemover;
  CommandRegistry::RegisterCommand(u"self", u"", std::shared_ptr<Command>(raw));
  EXPECT_TRUE(ExecuteCommand(u"self", mOut));
  EXPECT_FALSE(CommandRegistry::IsCommandRegistered(u"self"));
}

TEST_F(ConsoleTest, ACommandMayRunOtherCommands) {
  RegisterRecorder(u"inner");
  CommandRegistry::RegisterCommand(u"batch", u"", Lambda([](const CommandLine&, std::ostream& out) {
                                     ExecuteCommand(u"inner 1", out);
                                     ExecuteCommand(u"inner 2", out);
                                   }));
  EXPECT_TRUE(ExecuteCommand(u"batch", mOut));
  EXPECT_EQ(mRuns, (std::vector<std::string>{"inner|1|<1>", "inner|2|<2>"}));
}

TEST_F(ConsoleTest, AnExceptionFromACommandReachesTheCaller) {
  CommandRegistry::RegisterCommand(u"boom", u"", Lambda([](const CommandLine&, std::ostream&) {
                                     throw std::runtime_error("boom");
                                   }));
  EXPECT_THROW(ExecuteCommand(u"boom", mOut), std::runtime_error);
}

TEST_F(ConsoleTest, BadRegistrationsAreContractViolations) {
  tarsel::testing::TraceRecorder trace;
  auto factory = [] { return std::make_unique<LambdaCommand>([](const CommandLine&, std::ostream&) {}); };
  EXPECT_THROW(CommandRegistry::RegisterCommand(u"", u"", factory), tarsel::config::Exception);
  EXPECT_THROW(CommandRegistry::RegisterCommand(u"two words", u"", factory), tarsel::config::Exception);
  EXPECT_THROW(CommandRegistry::RegisterCommand(u"null", u"", CommandFactory()), tarsel::config::Exception);
  EXPECT_THROW(CommandRegistry::RegisterCommand(u"null", u"", std::shared_ptr<Command>()),
               tarsel::config::Exception);
  CommandRegistry::RegisterCommand(u"nothing", u"", [] { return std::unique_ptr<Command>(); });
  EXPECT_THROW(ExecuteCommand(u"nothing", mOut), tarsel::config::Exception);
  EXPECT_EQ(CommandRegistry::GetCommandNames().size(), 1u);
}

namespace {
fs::path TempPath(const std::string& inName) {
  return fs::temp_directory_path() / ("norvik_console_" + std::to_string(::getpid()) + "_" + inName);
}

std::string ReadFile(const fs::path& inPath) {
  std::ifstream in(inPath, std::ios::binary);
  return std::string(std::istreambuf_iterator<char>(in), {});
}

UTF8String U8(const fs::path& p) { return UTF8String(p.string().c_str()); }
}  // namespace

TEST_F(ConsoleTest, TheLastTerminateEmptiesTheRegistryAndClosesTheLog) {
  const fs::path path = TempPath("terminate.log");
  EXPECT_TRUE(Initialize());
  EXPECT_FALSE(Initialize());
  RegisterRecorder(u"con.help");
  ASSERT_TRUE(ConsoleLogFile::GetInstance().OpenLogFile(U8(path)));
  Terminate();
  EXPECT_TRUE(IsInitialized());
  EXPECT_TRUE(CommandRegistry::IsCommandRegistered(u"con.help"));
  Terminate();
  EXPECT_FALSE(IsInitialized());
  EXPECT_FALSE(CommandRegistry::IsCommandRegistered(u"con.help"));
  EXPECT_FALSE(ConsoleLogFile::GetInstance().IsLogFileOpen());
  tarsel::testing::TraceRecorder trace;
  EXPECT_THROW(Terminate(), tarsel::config::Exception);
  fs::remove(path);
}

TEST(ConsoleLogFile, WritesUtf8AndUtf16TextAddingOneLineEndWhenAskedAndStartsAfreshWhenOpenedAgain) {
  const fs::path path = TempPath("write.log");
  ConsoleLogFile& log = ConsoleLogFile::GetInstance();
  ASSERT_TRUE(log.OpenLogFile(U8(path)));
  EXPECT_EQ(tarsel::utility::ToStdString(log.GetLogFilePath()), path.string());
  EXPECT_TRUE(log.WriteToLog("first", true));
  EXPECT_TRUE(log.WriteToLog("second\n", true));
  EXPECT_TRUE(log.WriteToLog(UTF16String(u"caf\u00e9 "), false));
  EXPECT_TRUE(log.WriteToLog("end", false));
  // Flushed at each write: readable before the log closes.
  EXPECT_EQ(ReadFile(path), "first\nsecond\ncaf\xC3\xA9 end");
  ASSERT_TRUE(log.OpenLogFile(U8(path)));
  log.WriteToLog("new", true);
  EXPECT_EQ(ReadFile(path), "new\n") << "opening again starts the file afresh";
  log.CloseLogFile();
  EXPECT_TRUE(log.GetLogFilePath().empty());
  EXPECT_FALSE(log.WriteToLog("after close", true));
  fs::remove(path);
}

TEST(ConsoleLogFile, ABadPathFailsAndLeavesNoLogOpen) {
  ConsoleLogFile& log = ConsoleLogFile::GetInstance();
  EXPECT_FALSE(log.OpenLogFile(U8(TempPath("no/such/dir/x.log"))));
  EXPECT_FALSE(log.OpenLogFile(UTF8String()));
  EXPECT_FALSE(log.IsLogFileOpen());
  EXPECT_FALSE(log.WriteToLog("nowhere", true));
}

TEST(ConsoleLogFile, AFileInUseAsAnotherLogIsRefusedAndLeftIntact) {
  const fs::path path = TempPath("busy.log");
  { std::ofstream(path) << "someone else's log\n"; }
  int fd = ::open(path.c_str(), O_WRONLY);
  ASSERT_GE(fd, 0);
  ASSERT_EQ(::flock(fd, LOCK_EX | LOCK_NB), 0);
  EXPECT_FALSE(ConsoleLogFile::GetInstance().OpenLogFile(U8(path)));
  EXPECT_EQ(ReadFile(path), "someone else's log\n");
  ::close(fd);
  EXPECT_TRUE(ConsoleLogFile::GetInstance().OpenLogFile(U8(path)));
  ConsoleLogFile::GetInstance().CloseLogFile();
  fs::remove(path);
}
