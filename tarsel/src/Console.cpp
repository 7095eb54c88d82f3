#include "tarsel/Console.h"

#include "tarsel/Contract.h"
#include "tarsel/ConsoleLogFile.h"

namespace tarsel::console {
namespace {

bool IsBlank(char16_t c) { return c == u' ' || c == u'\t' || c == u'\r' || c == u'\n'; }

UTF16String AsciiLower(const UTF16String& inText) {
  UTF16String lower = inText;
  for (char16_t& c : lower)
    if (c >= u'A' && c <= u'Z') c = static_cast<char16_t>(c - u'A' + u'a');
  return lower;
}

struct Entry {
  UTF16String mName;
  UTF16String mHelp;
  CommandFactory mFactory;
  std::shared_ptr<Command> mShared;
};

struct Registry {
  std::mutex mMutex;
  std::map<UTF16String, Entry> mEntries;  // by lower-case name
  int mInitializeCount = 0;
};

Registry& GetRegistry() {
  static Registry* registry = new Registry;  // outlives static destruction
  return *registry;
}

void WriteUTF16(std::ostream& outStream, const UTF16String& inText) {
  UTF8String text = utility::UTF16to8(inText);
  outStream.write(text.data(), static_cast<std::streamsize>(text.size()));
}

void CheckName(const UTF16String& inName) {
  NRK_CONTRACT(!inName.empty());
  for (char16_t c : inName) NRK_CONTRACT(!IsBlank(c) && c != u'"');
}

void AddEntry(Entry inEntry) {
  CheckName(inEntry.mName);
  Registry& registry = GetRegistry();
  UTF16String key = AsciiLower(inEntry.mName);
  std::lock_guard<std::mutex> lock(registry.mMutex);
  registry.mEntries[key] = std::move(inEntry);
}

}  // namespace

CommandLine ParseCommandLine(const UTF16String& inLine) {
  CommandLine result;
  std::size_t i = 0;
  const std::size_t size = inLine.size();
  bool first = true;
  while (true) {
    while (i < size && IsBlank(inLine[i])) ++i;
    if (i >= size) break;
    if (!first && result.mArgumentText.empty()) {
      std::size_t end = size;
      while (end > i && IsBlank(inLine[end - 1])) --end;
      result.mArgumentText = inLine.substr(i, end - i);
    }
    UTF16String word;
    bool quoted = false;
    for (; i < size && (quoted || !IsBlank(inLine[i])); ++i) {
      if (inLine[i] == u'"')
        quoted = !quoted;
      else
        word.push_back(inLine[i]);
    }
    if (first)
      result.mName = std::move(word);
    else
      result.mArguments.push_back(std::move(word));
    first = false;
  }
  return result;
}

void CommandRegistry::RegisterCommand(const UTF16String& inName, const UTF16String& inHelp,
                                      CommandFactory inFactory) {
  NRK_CONTRACT(static_cast<bool>(inFactory));
  AddEntry(Entry{inName, inHelp, std::move(inFactory), nullptr});
}

void CommandRegistry::RegisterCommand(const UTF16String& inName, const UTF16String& inHelp,
                                      std::shared_ptr<Command> inCommand) {
  NRK_CONTRACT(inCommand != nullptr);
  AddEntry(Entry{inName, inHelp, nullptr, std::move(inCommand)});
}

bool CommandRegistry::UnregisterCommand(const UTF16String& inName) {
  Registry& registry = GetRegistry();
  std::lock_guard<std::mutex> lock(registry.mMutex);
  return registry.mEntries.erase(AsciiLower(inName)) > 0;
}

bool CommandRegistry::IsCommandRegistered(const UTF16String& inName) {
  Registry& registry = GetRegistry();
  std::lock_guard<std::mutex> lock(registry.mMutex);
  return registry.mEntries.count(AsciiLower(inName)) > 0;
}

bool CommandRegistry::ExecuteCommand(const UTF16String& inLine, std::ostream& outStream) {
  CommandLine line = ParseCommandLine(inLine);
  if (line.mName.empty()) return true;
  CommandFactory factory;
  std::shared_ptr<Command> command;
  {
    Registry& registry = GetRegistry();
    std::lock_guard<std::mutex> lock(registry.mMutex);
    auto it = registry.mEntries.find(AsciiLower(line.mName));
    if (it == registry.mEntries.end()) return false;
    // Copies: the command may unregister itself while it runs.
    factory = it->second.mFactory;
    command = it->second.mShared;
  }
  if (factory) {
    std::unique_ptr<Command> made = factory();
    NRK_CONTRACT(made != nullptr);
    made->Execute(line, outStream);
  } else {
    command->Execute(line, outStream);
  }
  return true;
}

void CommandRegistry::ListCommands(std::ostream& outStream) {
  std::vector<UTF16String> lines;
  {
    Registry& registry = GetRegistry();
    std::lock_guard<std::mutex> lock(registry.mMutex);
    for (const auto& entry : registry.mEntries)
      lines.push_back(entry.second.mHelp.empty() ? entry.second.mName : entry.second.mHelp);
  }
  for (const UTF16String& line : lines) {
    WriteUTF16(outStream, line);
    outStream.put('\n');
  }
  outStream.flush();
}

std::vector<UTF16String> CommandRegistry::GetCommandNames() {
  Registry& registry = GetRegistry();
  std::lock_guard<std::mutex> lock(registry.mMutex);
  std::vector<UTF16String> names;
  for (const auto& entry : registry.mEntries) names.push_back(entry.second.mName);
  return names;
}

void CommandRegistry::UnregisterAll() {
  Registry& registry = GetRegistry();
  std::map<UTF16String, Entry> gone;
  {
    std::lock_guard<std::mutex> lock(registry.mMutex);
    gone.swap(registry.mEntries);
  }
  // Commands are destroyed outside the lock: a destructor may touch the registry.
}

bool ExecuteCommand(const UTF16String& inLine, std::ostream& outStream) {
  return CommandRegistry::ExecuteCommand(inLine, outStream);
}

void ListCommands(std::ostream& outStream) { CommandRegistry::ListCommands(outStream); }

bool Initialize() {
  Registry& registry = GetRegistry();
  std::lock_guard<std::mutex> lock(registry.mMutex);
  return ++registry.mInitializeCount == 1;
}

void Terminate() {
  Registry& registry = GetRegistry();
  bool wasInitialized;
  {
    std::lock_guard<std::mutex> lock(registry.mMutex);
    wasInitialized = registry.mInitializeCount > 0;
    if (wasInitialized && --registry.mInitializeCount > 0) return;
  }
  NRK_CONTRACT(wasInitialized);  // outside the lock: the report may reach a console command
  CommandRegistry::UnregisterAll();
  ConsoleLogFile::GetInstance().CloseLogFile();
}

bool IsInitialized() {
  Registry& registry = GetRegistry();
  std::lock_guard<std::mutex> lock(registry.mMutex);
  return registry.mInitializeCount > 0;
}

}  // namespace tarsel::console
