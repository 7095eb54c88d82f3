// The gallery: shows what the toolkit can do. Until native windows exist it
// reports the library it was built against and the services it checked.
#include <cstdio>

#include "tarsel/Localizer.h"
#include "tarsel/MatrixT.h"
#include "tarsel/UTFString.h"

int main() {
  using namespace tarsel;
  UTF16String title = config::Localize("$$$/norvik/gallery/Title=norvik gallery");
  geom::MatrixF m = geom::MatrixF::Scale(2, 2);
  bool invertible = m.Invert(false);
  std::printf("%s\n", utility::ToStdString(utility::UTF16to8(title)).c_str());
  std::printf("core services loaded; matrix inversion %s\n", invertible ? "works" : "FAILED");
  std::printf("native windows are not built yet: the gallery has no window to show.\n");
  return invertible ? 0 : 1;
}
