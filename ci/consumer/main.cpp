// An outside program built against the installed package.
#include <cstdio>
#include <tarsel/Localizer.h>
#include <tarsel/RectT.h>
int main() {
  tarsel::geom::RectL r(0, 0, 10, 10);
  auto text = tarsel::utility::UTF16to8(tarsel::config::Localize("$$$/consumer/Hello=hello from norvik"));
  std::printf("%s, area %ld\n", text.c_str(), r.Width() * r.Height());
  return r.Contains(tarsel::geom::PointL(5, 5)) ? 0 : 1;
}
