#include "tests/support/recording/RecordingLisp.h"

const bool recordingHostRemovesTsLisp = RECORDING_HOST_REMOVES_TS_LISP;
