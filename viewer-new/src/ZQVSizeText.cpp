#include "ZQVSizeText.h"

#include "ZQVCommon.h"
#include "ZQVText.h"

ZQVSizeText::ZQVSizeText(uint64_t bytes) {
  float value = 0;
  unit.reset(ZQViewerCommon::getInstance().zquiCommonConvertFileSizeUnit(bytes, &value));
  g_snprintf(number, sizeof number, "%.2f", static_cast<double>(value));
}

std::string zqvFilesAndSize(int count, uint64_t bytes) {
  const ZQVSizeText size(bytes);
  if (count == 1) {
    return zqvFormat("IDS_RSH_SBODY_1_FILE_HP1SS_P2SS_ABB", "ss", size.number, size.unit.get());
  }
  return zqvFormat("IDS_RSH_SBODY_P1SD_FILES_HP2SS_P3SS_ABB", "dss", count, size.number,
                   size.unit.get());
}
