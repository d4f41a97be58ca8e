#include "TTextWriter_vmwesxi.h"

namespace braigrion {
namespace backends {

template class TBackendWriter_vmwesxi<TTextWriter>;

}  // namespace backends
}  // namespace braigrion
