#pragma once
// The console: a registry of named commands that a debug console (or a batch
// file, or a test) runs from a line of text. A line is split at blanks into
// the command name and its arguments; double quotes keep blanks inside one
// argument ("con.run \"/tmp/my file.txt\""). Names are matched without regard
// to ASCII case. Output goes to a narrow stream carrying UTF-8.
//
// The registry may be used from any thread. A command runs outside the
// registry's lock, so it may itself register, unregister or run commands.
#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <ostream>
#include <string>
#include <string_view>
#include <vector>

#include "tarsel/UTFString.h"

namespace tarsel::console {

// What a command is given: its name as typed, the arguments split at blanks
// (quotes removed), and the raw text after the name with surrounding blanks
// trimmed, for commands that want a path with blanks without quoting.
struct CommandLine {
  UTF16String mName;
  std::vector<UTF16String> mArguments;
  UTF16String mArgumentText;
};

// Splits a line as ExecuteCommand does. An unclosed quote runs to the end.
CommandLine ParseCommandLine(const UTF16String& inLine);

class Command {
 public:
  virtual ~Command() = default;
  virtual void Execute(const CommandLine& inLine, std::ostream& outStream) = 0;
};

using CommandFactory = std::function<std::unique_ptr<Command>()>;

class CommandRegistry {
 public:
  // Registers a command; a later registration of the same name replaces the
  // earlier one. A null factory or a name that is empty or has blanks is a
  // contract violation.
  static void RegisterCommand(const UTF16String& inName, const UTF16String& inHelp, CommandFactory inFactory);
  // Registers one shared command object.
  static void RegisterCommand(const UTF16String& inName, const UTF16String& inHelp,
                              std::shared_ptr<Command> inCommand);
  // Answers whether the command was registered.
  static bool UnregisterCommand(const UTF16String& inName);
  static bool IsCommandRegistered(const UTF16String& inName);
  // Runs a line. A line of blanks does nothing and answers true; an unknown
  // command writes nothing and answers false. An exception from a command is
  // not caught here.
  static bool ExecuteCommand(const UTF16String& inLine, std::ostream& outStream);
  // Writes the help text of every command, sorted by name, one per line (the
  // name when a command has no help text).
  static void ListCommands(std::ostream& outStream);
  // Every registered name, sorted.
  static std::vector<UTF16String> GetCommandNames();
  static void UnregisterAll();
};

bool ExecuteCommand(const UTF16String& inLine, std::ostream& outStream);
void ListCommands(std::ostream& outStream);

// Console start-up and shut-down, counted: each Initialize needs one
// Terminate, and the last Terminate empties the registry and closes the log
// file. Initialize answers true for the first call.
bool Initialize();
void Terminate();
bool IsInitialized();

}  // namespace tarsel::console
