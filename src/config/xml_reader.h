#ifndef OVO_CONFIG_XML_READER_H
#define OVO_CONFIG_XML_READER_H

#include <cstdio>

#include "config/xml_node.h"

namespace ovo {

// Elements nested deeper than this fail, so that hostile input cannot exhaust the stack.
constexpr int XML_DEPTH_LIMIT = 256;

// The document read from the file at `path` (a path of the running system, not a device
// path), owned by the caller; null when there is no regular file to open or a token
// error occurs between top-level elements.
XmlElement* ParseXmlFile(const char* path);

// The same for an open stream, which is left open.
XmlElement* ParseXmlStream(FILE* stream);

}  // namespace ovo

#endif
