#include "platform/qt/single_instance.h"

namespace kora {

SingleInstance::SingleInstance(const std::string& home, const std::string& name)
    : lock_(QString::fromStdString(home + "/" + name + ".lock")) {
  lock_.setStaleLockTime(0);  // a long run is no dead one
  previous_ = !lock_.tryLock(0) && lock_.error() == QLockFile::LockFailedError;
}

}  // namespace kora
