// The check amldump applies to a table signature before the signature
// becomes a file name.
#ifndef ORXKELTOOLS_PCI_AMLDUMP_H
#define ORXKELTOOLS_PCI_AMLDUMP_H

#include <string_view>

// True when the signature may name a file in the current folder: it is not
// empty, ".", or "..", holds no '/', holds only printable ASCII (so that
// "Writing file %s" cannot carry terminal control bytes), and does not
// start with '-' (so that the file is not taken for an option by the
// commands run on it later).
bool SafeSignature(std::string_view signature);

#endif
