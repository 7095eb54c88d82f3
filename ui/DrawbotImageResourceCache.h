#pragma once
// The seam to the cache of decoded images and fonts. The image work implements
// it; the manager holds one and destroys it in TerminateDrawing.
namespace norvik::ui {

class DrawbotImageResourceCache {
 public:
  virtual ~DrawbotImageResourceCache() = default;

  // Forgets every cached object.
  virtual void Clear() = 0;
};

}  // namespace norvik::ui
