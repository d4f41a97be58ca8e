// The text back-end of the ESXi report: index.txt and a text page per link
// name, tables as aligned columns, as the base text back-end writes them.
#pragma once

#include "TBackendWriter_vmwesxi.h"
#include "TTextWriter.h"

namespace braigrion {
namespace backends {

class TTextWriter_vmwesxi : public TBackendWriter_vmwesxi<TTextWriter> {};

}  // namespace backends
}  // namespace braigrion
