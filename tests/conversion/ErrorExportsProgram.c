/* The error exports as a C application sees them, through nothing but
 * libhsdigRemote.so. Exits 0 when every check holds; prints each failure. */
#include <stdio.h>
#include <string.h>

#include "hsdigRemote/hsdigRemote.h"

static int failures = 0;

static void check(int ok, const char* what) {
  if (!ok) {
    fprintf(stderr, "FAILED: %s\n", what);
    ++failures;
  }
}

int main(void) {
  const ViStatus timedOut = (ViStatus)0xBFFA9157;
  ViStatus code = 12345;
  char text[1024];
  ViInt32 length;
  ViStatus status;

  check(hsdigRemote_ClearError(0) == 0, "ClearError of session 0 succeeds");
  status = hsdigRemote_GetError(0, &code, (ViInt32)sizeof text, text);
  check(status == 0, "GetError of session 0 returns 0");
  check(code == 0, "GetError of a cleared session 0 gives code 0");

  length = hsdigRemote_GetErrorMessage(0, timedOut, 0, NULL);
  check(length > 0, "GetErrorMessage with size 0 gives the text length");
  memset(text, 'x', sizeof text);
  status = hsdigRemote_GetErrorMessage(0, timedOut, (ViInt32)sizeof text, text);
  check(status == 0, "GetErrorMessage with a large buffer returns 0");
  check((ViInt32)strlen(text) == length, "the whole text arrives, terminated");
  check(text[sizeof text - 1] == '\0', "the rest of the buffer is zero-filled");
  memset(text, 'x', sizeof text);
  status = hsdigRemote_GetErrorMessage(0, timedOut, 5, text);
  check(status == 0, "GetErrorMessage with a small buffer returns 0");
  check(text[5] == 'x', "no byte beyond the given size is written");
  check(hsdigRemote_GetErrorMessage(0, timedOut, -1, text) == (ViStatus)0xBFFA000F,
        "size -1 gives 0xBFFA000F");
  check(hsdigRemote_QLGetErrorMessage(0, timedOut, 0, NULL) == length,
        "the host-environment twin forwards");

  if (failures == 0) printf("error exports: all checks passed\n");
  return failures == 0 ? 0 : 1;
}
