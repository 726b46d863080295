// VLRecordJson: the client records of the flat interface (VL_WS_Records.h) as JSON values.
//
// A record becomes an object whose members carry the record's field names, base fields first;
// an array record, and an array field with its count, becomes a JSON array; a record inside a
// record is written by the same function as on its own. Image bytes are written in Base64.
// Plain results of the interface (bool, int, ...) are written by the caller.
#ifndef VLRECORDJSON_H
#define VLRECORDJSON_H

#include "VLJsonWriter.h"
#include "VL_WS.h"

// The results of the interface's operations. Each writes one complete JSON value.
void VLJsonValue(VLJsonWriter& json, const VL_WS_String& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_StandardResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_BoolArray& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_Version& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_EnvList& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_Image& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_FileType& record);
// Catalogue
void VLJsonValue(VLJsonWriter& json, const VL_WS_GenreArray& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_GenreLabelResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_TitleListingResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_TitleListingResponseArray& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_TitlesResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_TitlesResponseArray& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_RecommendedTitlesResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_TvEpisodeListResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_TranslateTivoExternalIDResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_TranslateSkuIDResponse& record);
// Account and purchases
void VLJsonValue(VLJsonWriter& json, const VL_WS_AuthorizeDeviceResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_MyVideosResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_WishlistItemsResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_TitleListingPurchasedForPassArray& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_PurchaseResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_OrderTaxResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_GiftCertificateResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_PrePaidCardBalanceResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_BillingInfoResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_BillingInfoAndPPCBalance& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_AdultVerificationEnabledResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_AdultVerificationPinResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_RentalExpirationResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_EmailAddressResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_SettingsPageResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_ConfigResponse& record);
// Streaming
void VLJsonValue(VLJsonWriter& json, const VL_WS_StreamingAssetLocationResponse& record);
void VLJsonValue(VLJsonWriter& json, const VL_WS_THXMediaDirectorResponse& record);

#endif  // VLRECORDJSON_H
