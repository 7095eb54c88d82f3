// The adapter and node registries, and the tag that fills the node registry.
#include "ui/UI_Node.h"
#include "ui/UI_NodeAdapterBase.h"
#include "ui/UI_NodeTag.h"

namespace norvik::ui {

// Function-local statics: adapters are global objects of several libraries,
// constructed in an order no file controls.
UI_NodeAdapterBase::AdapterMap& UI_NodeAdapterBase::Adapters() {
  static AdapterMap adapters;
  return adapters;
}

std::map<const UI_Node*, UI_NodeAdapterBase::NodeAdapterEntry>& UI_NodeAdapterBase::Nodes() {
  static std::map<const UI_Node*, NodeAdapterEntry> nodes;
  return nodes;
}

UI_NodeAdapterBase::UI_NodeAdapterBase(const UTF16String& inName, const UI_NodeAdapterBase* inBase,
                                       bool inCanCreate, bool inCanHaveChildren)
    : mName(inName), mBase(inBase), mCanCreate(inCanCreate), mCanHaveChildren(inCanHaveChildren) {
  Adapters()[mName] = this;
}

UI_NodeAdapterBase::~UI_NodeAdapterBase() {
  AdapterMap& adapters = Adapters();
  auto it = adapters.find(mName);
  if (it != adapters.end() && it->second == this) adapters.erase(it);
}

const UI_NodeAdapterBase* UI_NodeAdapterBase::GetAdapterForName(const UTF16String& inName) {
  const AdapterMap& adapters = Adapters();
  auto it = adapters.find(inName);
  return it == adapters.end() ? nullptr : it->second;
}

const UI_NodeAdapterBase* UI_NodeAdapterBase::GetAdapterForNode(const UI_Node* inNode) {
  auto& nodes = Nodes();
  auto it = nodes.find(inNode);
  return it == nodes.end() ? nullptr : it->second.adapter;
}

UTF16String UI_NodeAdapterBase::GetClassNameForNode(const UI_Node* inNode) {
  auto& nodes = Nodes();
  auto it = nodes.find(inNode);
  return it == nodes.end() ? UTF16String() : it->second.className;
}

void UI_NodeAdapterBase::RegisterNode(const UI_Node* inNode, const UI_NodeAdapterBase* inAdapter,
                                      const UTF16String& inClassName) {
  if (!inNode) return;
  Nodes()[inNode] = NodeAdapterEntry{inAdapter, inClassName};
}

void UI_NodeAdapterBase::UnregisterNode(const UI_Node* inNode) { Nodes().erase(inNode); }

UI_NodeAdapterBase::AdapterMap::const_iterator UI_NodeAdapterBase::AdapterBegin() { return Adapters().begin(); }

UI_NodeAdapterBase::AdapterMap::const_iterator UI_NodeAdapterBase::AdapterEnd() { return Adapters().end(); }

UI_NodeTag::UI_NodeTag(const boost::intrusive_ptr<UI_Node>& inNode, const UI_NodeAdapterBase* inAdapter,
                       const UTF16String& inClassName)
    : mNode(inNode), mAdapter(inAdapter), mClassName(inClassName) {
  UI_NodeAdapterBase::RegisterNode(mNode.get(), mAdapter, mClassName);
}

UI_NodeTag::~UI_NodeTag() { UI_NodeAdapterBase::UnregisterNode(mNode.get()); }

void UI_NodeTag::SetClassName(const UTF16String& inClassName) {
  mClassName = inClassName;
  UI_NodeAdapterBase::RegisterNode(mNode.get(), mAdapter, mClassName);
}

}  // namespace norvik::ui
