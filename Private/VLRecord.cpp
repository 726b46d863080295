// Tagging of the records nested in client records.
#include "VLRecord.h"

#include "VLUtilities.h"

void VLRecordInitNested(const void* record) {}

void VLRecordInitNested(VL_WS_ProductListing* record) {
  VLRecordInit(record->AvailableAssets);
  VLRecordInit(record->AvailableAudioProfiles);
}

void VLRecordInitNested(VL_WS_TitleListing* record) {
  VLRecordInit(record->BonusAssets);
  VLRecordInit(record->AvailableProducts);
}

void VLRecordInitNested(VL_WS_TitlesResponse* record) { VLRecordInit(record->Titles); }

void VLRecordInitNested(VL_WS_RecommendedTitlesResponse* record) { VLRecordInit(record->Titles); }

void VLRecordInitNested(VL_WS_TvEpisodeListResponse* record) { VLRecordInit(record->Episodes); }

void VLRecordInitNested(VL_WS_MyVideosResponse* record) { VLRecordInit(record->Titles); }

void VLRecordInitNested(VL_WS_BillingInfoAndPPCBalance* record) {
  VLRecordInit(record->BillingInfo);
  VLRecordInit(record->PPCardBalance);
}

void VLRecordSetString(VL_WS_String& record, const char* text) {
  record.Text = VLUtilities::StrDup(text);
  record.Length = static_cast<int>(strlen(record.Text));
}
