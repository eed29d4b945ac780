/* The C interface of the optional translator manager library
 * ("libcvxlator.so"), an outside component. When a process has it, translator
 * sessions and translators come from it instead of the built-in translator.
 *
 * Every function returns 0 on success and a negative status on failure.
 * A translator is described by a table of functions that the manager fills
 * in; the texts it hands out are UTF-8, allocated by the manager and given
 * back through freeText. A session and its translators are used by one thread
 * at a time. */
#ifndef HSDIG_ERRORS_TRANSLATOR_CVXLATORMGR_H
#define HSDIG_ERRORS_TRANSLATOR_CVXLATORMGR_H

#include <stdint.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef struct cvxlatormgr_Xlator {
  void* handle;
  /* The static description of `code` in `*text`. */
  int32_t (*getStaticDesc)(void* handle, int32_t code, int32_t language, int32_t ade, char** text);
  /* The dynamic items of a description, as {"dynamic": [...], "debug": [...]}
   * JSON text, in `*text`. On failure `*text` may hold a message. */
  int32_t (*getDynamicDesc)(void* handle, const char* errjson, int32_t language, int32_t ade,
                            const char* format, char** text);
  void (*freeText)(char* text);
} cvxlatormgr_Xlator;

typedef int32_t (*cvxlatormgr_createSession_fn)(void** session);
typedef int32_t (*cvxlatormgr_destroySession_fn)(void* session);
/* Fills `xlator` for the translator named `name` (for example "mxlator_hsdig"). */
typedef int32_t (*cvxlatormgr_createXlator_fn)(void* session, const char* name,
                                               cvxlatormgr_Xlator* xlator);
typedef int32_t (*cvxlatormgr_destroyXlator_fn)(void* session, cvxlatormgr_Xlator* xlator);

#ifdef __cplusplus
}
#endif

#endif /* HSDIG_ERRORS_TRANSLATOR_CVXLATORMGR_H */
