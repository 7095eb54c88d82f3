#pragma once
// A cache keeps the rendered pixels of a node so that a later paint can put
// them back without drawing the node again. A surface makes one with
// PushCacheStack and draws it with DrawCache; IsValid tells whether the pixels
// still fit the surface's current transform, policies and the rectangle asked for.
#include <boost/intrusive_ptr.hpp>

#include "tarsel/RectT.h"
#include "tarsel/RefCountedObject.h"

namespace norvik::drawbot {

class SurfaceInterface;

class CacheInterface : public tarsel::utility::RefCountedObject {
 public:
  ~CacheInterface() override = default;

  // The surface the cached pixels were drawn into; null when the cache holds nothing.
  virtual SurfaceInterface* GetSurface() const = 0;

  // True when drawing this cache on inSurface gives the same pixels as drawing
  // the source of inRect there again.
  virtual bool IsValid(SurfaceInterface const& inSurface,
                       tarsel::geom::RectT<float> const& inRect) const = 0;
};

using CacheInterfaceP = boost::intrusive_ptr<CacheInterface>;

}  // namespace norvik::drawbot
