#include "tessal/version.h"

namespace tessal {
inline namespace v1 {

const char* Version() {
  return TESSAL_VERSION;
}

}  // namespace v1
}  // namespace tessal
