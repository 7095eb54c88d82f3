#pragma once
// The registries behind the node archive. Every adapter (one per archivable
// node class) enters itself by name when it is constructed; every live node
// that can be archived is entered with its adapter and class name by a
// UI_NodeTag for as long as the tag lives. The per-class archive operations
// are added to this class by the archive work.
#include <map>

#include "tarsel/Flags.h"
#include "tarsel/UTFString.h"

namespace tarsel::proplist {
class PropList;
}

namespace norvik::ui {

class UI_Node;

class UI_NodeAdapterBase {
 public:
  struct NodeAdapterEntry {
    const UI_NodeAdapterBase* adapter = nullptr;
    UTF16String className;
  };
  using AdapterMap = std::map<UTF16String, const UI_NodeAdapterBase*>;

  // Enters this adapter under inName; a later adapter of the same name
  // replaces the earlier one.
  UI_NodeAdapterBase(const UTF16String& inName, const UI_NodeAdapterBase* inBase, bool inCanCreate,
                     bool inCanHaveChildren);
  UI_NodeAdapterBase(const UI_NodeAdapterBase&) = delete;
  UI_NodeAdapterBase& operator=(const UI_NodeAdapterBase&) = delete;
  virtual ~UI_NodeAdapterBase();

  const UTF16String& GetName() const { return mName; }
  const UI_NodeAdapterBase* GetBaseAdapter() const { return mBase; }
  bool CanCreateObject() const { return mCanCreate; }
  virtual bool CanHaveChildren() const { return mCanHaveChildren; }

  static const UI_NodeAdapterBase* GetAdapterForName(const UTF16String& inName);
  static const UI_NodeAdapterBase* GetAdapterForNode(const UI_Node* inNode);
  // Empty when the node is not registered.
  static UTF16String GetClassNameForNode(const UI_Node* inNode);
  static void RegisterNode(const UI_Node* inNode, const UI_NodeAdapterBase* inAdapter,
                           const UTF16String& inClassName);
  static void UnregisterNode(const UI_Node* inNode);
  static AdapterMap::const_iterator AdapterBegin();
  static AdapterMap::const_iterator AdapterEnd();

  // Number format flags as one boolean per bit ("formatNoLocalization",
  // "formatLeadingSpaces", ...), plus "formatNormal", which is always written
  // false and ignored when read. Reading ignores unknown keys and raises the
  // property-list error for a flag key that does not hold a boolean.
  static void NumberFormatFlagsToPropList(tarsel::utility::Flags<unsigned short> inFlags,
                                          tarsel::proplist::PropList& ioList);
  static tarsel::utility::Flags<unsigned short> NumberFormatFlagsFromPropList(
      const tarsel::proplist::PropList& inList);

 private:
  static AdapterMap& Adapters();
  static std::map<const UI_Node*, NodeAdapterEntry>& Nodes();

  UTF16String mName;
  const UI_NodeAdapterBase* mBase;
  bool mCanCreate;
  bool mCanHaveChildren;
};

}  // namespace norvik::ui
