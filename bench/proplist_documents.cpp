// Writing and reading large prop-list documents shaped like view-tree archives,
// and JSON text of a long tool list. Compare the ratios between sizes within
// one run: the machines are shared.
#include <benchmark/benchmark.h>

#include <string>

#include "tarsel/JSONSerialization.h"
#include "tarsel/PropListUtils.h"

namespace {

using tarsel::proplist::PropList;

// A node record as archives hold them: adapter, sections with properties,
// and children, "fanOut" per node down to "depth" levels.
void FillNode(PropList& ioNode, int inDepth, int inFanOut) {
  ioNode.SetValue("adapter", u"norvik::controls::UI_TextButton");
  auto sections = ioNode.NewSubList("sections");
  sections->SetValue("count", std::uint32_t{2});
  auto own = sections->NewSubList("section-0");
  own->SetValue("sectionName", u"norvik::controls::UI_TextButton");
  own->SetValue("text", u"($$$/norvik/dialogs/OK=OK)");
  own->SetValue("enabled", true);
  auto bounds = own->NewSubList("bounds");
  bounds->SetValue(".aptype", std::int32_t{1});
  bounds->SetValue("left", 10.0f);
  bounds->SetValue("top", 20.5f);
  bounds->SetValue("width", 120.0f);
  bounds->SetValue("height", 22.0f);
  auto base = sections->NewSubList("section-1");
  base->SetValue("sectionName", u"norvik::ui::UI_Node");
  base->SetValue("id", "okButton");
  if (inDepth == 0) return;
  auto children = own->NewSubList("children");
  children->SetValue("count", static_cast<std::uint32_t>(inFanOut));
  for (int i = 0; i < inFanOut; ++i) FillNode(*children->NewSubList("child-" + std::to_string(i)), inDepth - 1, inFanOut);
}

PropList MakeArchive(int inDepth) {
  PropList archive;
  archive.SetValue("UINodeArchive", std::uint32_t{1});
  FillNode(*archive.NewSubList("root"), inDepth, 4);
  return archive;
}

void BM_WriteArchive(benchmark::State& state) {
  const PropList archive = MakeArchive(static_cast<int>(state.range(0)));
  std::size_t bytes = 0;
  for (auto _ : state) {
    UTF8String text = tarsel::proplist::utils::WritePropList(archive);
    bytes = text.size();
    benchmark::DoNotOptimize(text.data());
  }
  state.SetBytesProcessed(static_cast<int64_t>(bytes) * state.iterations());
  state.counters["doc_kb"] = static_cast<double>(bytes) / 1024.0;
}
BENCHMARK(BM_WriteArchive)->Arg(3)->Arg(5)->Arg(6)->Unit(benchmark::kMillisecond);

void BM_ReadArchive(benchmark::State& state) {
  const UTF8String text = tarsel::proplist::utils::WritePropList(MakeArchive(static_cast<int>(state.range(0))));
  for (auto _ : state) {
    PropList list;
    tarsel::proplist::utils::ReadPropList(text, list);
    benchmark::DoNotOptimize(list.Size());
  }
  state.SetBytesProcessed(static_cast<int64_t>(text.size()) * state.iterations());
}
BENCHMARK(BM_ReadArchive)->Arg(3)->Arg(5)->Arg(6)->Unit(benchmark::kMillisecond);

void BM_CopyArchive(benchmark::State& state) {
  const PropList archive = MakeArchive(static_cast<int>(state.range(0)));
  for (auto _ : state) {
    PropList copy(archive);
    benchmark::DoNotOptimize(copy.Size());
  }
}
BENCHMARK(BM_CopyArchive)->Arg(5)->Unit(benchmark::kMillisecond);

void BM_JSONToolListRoundTrip(benchmark::State& state) {
  boost::any tools;
  for (int i = 0; i < state.range(0); ++i) {
    boost::any tool;
    tarsel::serialization::AddToObject(tool, "id", std::int64_t{i});
    tarsel::serialization::AddToObject(tool, "tip", UTF16String(u"Razor tool"));
    tarsel::serialization::AddToObject(tool, "spacer", false);
    tarsel::serialization::AppendToArray(tools, tool);
  }
  boost::any root;
  tarsel::serialization::AddToObject(root, "mToolBarItemsInfo", tools);
  for (auto _ : state) {
    const UTF8String text = tarsel::serialization::GetJSONString(root);
    benchmark::DoNotOptimize(tarsel::serialization::JSONParse(text));
  }
}
BENCHMARK(BM_JSONToolListRoundTrip)->Arg(100)->Arg(10000)->Unit(benchmark::kMillisecond);

}  // namespace
