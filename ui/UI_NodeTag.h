#pragma once
// A UI_NodeTag keeps a node known to the adapter registry, with its adapter
// and class name, for exactly as long as the tag lives.
#include <boost/intrusive_ptr.hpp>
#include <boost/noncopyable.hpp>

#include "tarsel/RefCountedObject.h"
#include "tarsel/UTFString.h"

namespace norvik::ui {

class UI_Node;
class UI_NodeAdapterBase;

class UI_NodeTag : public tarsel::utility::RefCountedObject, private boost::noncopyable {
 public:
  UI_NodeTag(const boost::intrusive_ptr<UI_Node>& inNode, const UI_NodeAdapterBase* inAdapter,
             const UTF16String& inClassName);
  ~UI_NodeTag() override;

  UI_Node* GetNode() const { return mNode.get(); }
  const UI_NodeAdapterBase* GetAdapter() const { return mAdapter; }
  const UTF16String& GetClassName() const { return mClassName; }
  // Stores a new class name and enters it in the registry.
  void SetClassName(const UTF16String& inClassName);

 private:
  boost::intrusive_ptr<UI_Node> mNode;
  const UI_NodeAdapterBase* mAdapter;
  UTF16String mClassName;
};

using UI_NodeTagP = boost::intrusive_ptr<UI_NodeTag>;

}  // namespace norvik::ui
