// The HTML back-end of the ESXi report: the report directory of the base
// HTML back-end (index.html, navbar.html, a page per link name, the
// built-in stylesheet and sort script), written for the ESXi writer.
#pragma once

#include "TBackendWriter_vmwesxi.h"
#include "THtmlWriter.h"

namespace braigrion {
namespace backends {

class THtmlWriter_vmwesxi : public TBackendWriter_vmwesxi<THtmlWriter> {};

}  // namespace backends
}  // namespace braigrion
