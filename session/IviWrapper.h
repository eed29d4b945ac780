// IviWrapper: the implementation of IviWrapperInterface over the engine
// binding. Small enough to live on the stack; IviWrapperFactory makes heap
// ones.
#pragma once

#include <memory>
#include <source_location>

#include "session/IviEngineBinding.h"
#include "session/IviWrapperInterface.h"

namespace hsdig {

class IviWrapper : public IviWrapperInterface {
 public:
  // A wrapper over `session` (0: no session, for the engine functions that
  // take none). `binding` is the process binding except in tests.
  explicit IviWrapper(ViSession session,
                      IviEngineBinding& binding = IviEngineBinding::process()) noexcept
      : session_(session), binding_(binding) {}

  ViSession getSessionHandle() const override { return session_; }

#define HSDIG_IVI_OP_STATUS(method, ret, sess, params) \
  ViStatus method(HSDIG_IVI_WITH_NOTHROW_DEFAULT(HSDIG_IVI_OP_PARAMS(sess, params))) override;
#define HSDIG_IVI_OP_VALUE(method, ret, sess, params) \
  ret method(HSDIG_IVI_OP_PARAMS(sess, params)) override;
#define HSDIG_IVI_OP_CLASS HSDIG_IVI_OP_VALUE
#define HSDIG_IVI_OP_DECLARE(cname, method, avail, kind, support, ret, sess, params, args) \
  IVI_ENGINE_CAT(HSDIG_IVI_OP_, kind)(method, ret, sess, params)
  IVI_ENGINE_FUNCTIONS(HSDIG_IVI_OP_DECLARE)
#undef HSDIG_IVI_OP_DECLARE
#undef HSDIG_IVI_OP_CLASS
#undef HSDIG_IVI_OP_VALUE
#undef HSDIG_IVI_OP_STATUS

 private:
  // The status rule of every status-returning operation.
  ViStatus settle(ViStatus status, int noThrow, bool returnsSize,
                  const std::source_location& where);

  const ViSession session_;
  IviEngineBinding& binding_;
};

// Makes heap wrappers; the caller owns them.
class IviWrapperFactory {
 public:
  explicit IviWrapperFactory(IviEngineBinding& binding = IviEngineBinding::process()) noexcept
      : binding_(&binding) {}
  virtual ~IviWrapperFactory() = default;
  virtual std::unique_ptr<IviWrapperInterface> create(ViSession session) const {
    return std::make_unique<IviWrapper>(session, *binding_);
  }

 private:
  IviEngineBinding* binding_;
};

}  // namespace hsdig
