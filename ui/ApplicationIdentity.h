#pragma once
// How the application names itself to the desktop: the instance and class
// names by which desktops match its windows to a launcher entry, and task
// bars and window rules recognise them. The toolkit's own window class stays
// the toolkit's internal identity and is not this.
#include <string>

namespace norvik::ui {

// The instance name: $RESOURCE_NAME when set, else the program's file name.
std::string GetApplicationInstanceName();
// The class name: what the application set, else the instance name with its
// first letter capitalised.
std::string GetApplicationClassName();
// Takes effect for windows made afterwards. An empty name restores the default.
void SetApplicationClassName(const std::string& inClassName);

}  // namespace norvik::ui
