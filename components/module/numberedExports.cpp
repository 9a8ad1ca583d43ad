#include "ovphoto/numberedExports.h"

const RnNumberedExport RnNumberedExports[] = {{0, nullptr}};
