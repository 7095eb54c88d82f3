#pragma once
// Platform settings that the toolkit folds into its custom settings: the
// platform is asked by name, and answers only the names it knows.
#include <string>

#include <boost/intrusive_ptr.hpp>

#include "tarsel/RefCountedObject.h"

namespace norvik::ui {

class OS_Preferences : public tarsel::utility::RefCountedObject {
 public:
  // True, with the value, when the platform answers inName.
  virtual bool Get(const std::string& inName, bool& outValue) const = 0;
};

using OS_PreferencesP = boost::intrusive_ptr<OS_Preferences>;

// The installed native layer's answers ("windows.MnemonicsAlwaysOn" and
// whatever else the port reads from the desktop's settings).
class OS_NativePreferences : public OS_Preferences {
 public:
  bool Get(const std::string& inName, bool& outValue) const override;
};

}  // namespace norvik::ui
