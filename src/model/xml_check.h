// The strict look at a file's text, ahead of the general parser: that one reads much that is no XML, such as two roots,
// an '&' that begins nothing or an attribute given twice, and what it makes of it is a guess that the next save would
// put in the place of the file.
#pragma once

#include "model/source_text.h"

// Whether the text, in UTF-8, is a well-formed document (XML 1.0, with its namespaces). Where the document declares
// entities or attributes of its own, they are put in their places in the text; any other text stays as it is.
[[nodiscard]] bool checkXml(SourceText& text);
