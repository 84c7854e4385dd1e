/// \file
/// Texts whose address is returned and stays valid forever.

#ifndef HOST_XOS_BASICS_SYSTEM_KEPT_TEXTS_H
#define HOST_XOS_BASICS_SYSTEM_KEPT_TEXTS_H

namespace host {

/// \return the one kept copy of the text, never freed; equal texts share it. Null is empty.
char const* keptText(char const* text);

} // namespace host

#endif
