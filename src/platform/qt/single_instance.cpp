#include "platform/qt/single_instance.h"

namespace kora {

SingleInstance::SingleInstance(const std::string& home, const std::string& name)
    : lock_(QString::fromStdString(home + "/" + name + ".lock")) {
  lock_.setStaleLockTime(0);  // a long run is no dead one
  const auto taken = [this] {
    return !lock_.tryLock(0) && lock_.error() == QLockFile::LockFailedError;
  };
  previous_ = taken();
  // Taking over the lock of a program that died needs a second file, for which a full disk has no
  // room. The lock of a program that runs can't be removed.
  if (previous_ && lock_.removeStaleLockFile()) previous_ = taken();
}

}  // namespace kora
