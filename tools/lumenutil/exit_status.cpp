#include "lumenutil/exit_status.h"

namespace lumenutil {
namespace {

int g_resultStatus = 0;
int g_errorStatus = 1;

}  // namespace

void SetResultStatus(int status) {
  g_resultStatus = status;
}

int ResultStatus() {
  return g_resultStatus;
}

void SetErrorStatus(int status) {
  g_errorStatus = status;
}

int ErrorStatus() {
  return g_errorStatus;
}

}  // namespace lumenutil
