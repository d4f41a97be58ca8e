#include "THtmlWriter_vmwesxi.h"

namespace braigrion {
namespace backends {

// The adapter is compiled once per base back-end, here and in
// TTextWriter_vmwesxi.cpp.
template class TBackendWriter_vmwesxi<THtmlWriter>;

}  // namespace backends
}  // namespace braigrion
