// VLUtilities: static helpers shared by the client, the cache and the configuration code. The
// functions are grouped by topic; each group is defined in its own source file, named below.
#ifndef VLUTILITIES_H
#define VLUTILITIES_H

#include <stddef.h>
#include <time.h>

#include "VLString.h"
#include "VL_WS_Records.h"

struct soap;

// Schema records of the store's answers (generated from soap/VL.h.in).
class VL1__ArrayOfGenre;
class VL1__ArrayOfGetTitlesResponse;
class VL1__ArrayOfTitleListing;
class VL1__ArrayOfTitleListingPurchasedForPass;
class VL1__ArrayOfTitleListingResponse;
class VL1__AuthorizeDeviceResponse;
class VL1__BillingInfoAndPPCBalanceResponse;
class VL1__BillingInfoResponse;
class VL1__CalcOrderTaxResponse;
class VL1__CheckAdultVerificationEnabledResponse;
class VL1__CheckAdultVerificationPinResponse;
class VL1__CheckRentalExpirationResponse;
class VL1__GetConfigResponse;
class VL1__GetEmailAddressResponse;
class VL1__GetGenreLabelResponse;
class VL1__GetMyVideosResponse;
class VL1__GetStreamingAssetLocationResponse;
class VL1__GetTitlesResponse;
class VL1__GetWishlistItemsResponse;
class VL1__GiftCertificateResponse;
class VL1__PPCardBalanceResponse;
class VL1__PurchaseResponse;
class VL1__RecommendedTitlesResponse;
class VL1__SettingsPageInfo;
class VL1__StandardResponse;
class VL1__THXMediaDirectorResponse;
class VL1__TitleListing;
class VL1__TitleListingPurchased;
class VL1__TitleListingResponse;
class VL1__TranslateSkuIdResponse;
class VL1__TranslatedTivoExternalIdResponse;
class VL1__TvEpisodeList;
class VL1__WishListActionResponse;

class VLUtilities {
 public:
  // ---- Basic utilities (VLUtilities.cpp) ------------------------------------------------------

  // A copy of s in a new array (release it with delete[]); null or empty s gives a new empty text.
  static char* StrDup(const char* s);
  // True when s is "true" in any letter case; false for any other text and for null.
  static bool Str2Bool(const char* s);
  // The store's number of a sort order: 0 to 3; any other value gives 0.
  static int SortOrder2Int(VL_WS_SortOrder order);
  // Percent-encodes every byte except A-Z, a-z, 0-9 and "-_.!~*'()" as "%XX" (upper-case hex).
  // Null or empty s gives the empty string.
  static VLString URLEncode(const char* s);
  // vsnprintf into buf (always terminated, truncated to bufsize - 1 bytes); returns buf.
  static char* safe_snprintf(char* buf, size_t bufsize, const char* format, ...)
#ifdef __GNUC__
      __attribute__((format(printf, 3, 4)))
#endif
      ;
  // "YYYY/MM/DD hh:mm:ss"
  static VLString TM2Str(const tm& t);
  // Wall-clock milliseconds, wrapping modulo 2^32: for measuring intervals.
  static unsigned int MillisecondTime();
  // 32-bit FNV-1 style hash of len bytes starting from seed (every caller passes 0). The cache
  // file name and the check digits of encrypted settings depend on these values: never change.
  static unsigned int Hash(unsigned int seed, const char* data, unsigned int len);
  // n bytes from the OpenSSL generator (seeded first when OpenSSL reports it unseeded).
  // Returns OpenSSL's result: 1 on success.
  static int RandomBytes(char* buf, unsigned int n);
  // "XX-XX-XX-XX-XX-XX": the hardware address of the first network interface whose address is
  // not all zero, or random bytes when there is none.
  static VLString GetUniqueIdentifier();

  // ---- Status conversion (VLUtilities_Status.cpp) ---------------------------------------------

  // The status of a SOAP runtime error: 0 for none, -2012 end of input, -2011 TCP, -5030 TLS,
  // -4000 - n for HTTP failures (an HTTP status n included), -6000 - n for SOAP protocol
  // failures, -1004 for anything else.
  static VL_WS_Status To_VL_WS_Status(int soapError);
  // The status of a call: a SOAP error wins; else response code 0 is success; else the code's
  // status for operations that map their codes ("VL_WS_authorizeDevice",
  // "VL_WS_doPurchaseSavedBilling", "VL_WS_getBillingInfo", "VL_WS_assignGiftCertificateToUser",
  // "VL_WS_calcOrderTax"); any other code, and any code with a null or empty operation, -1004.
  static VL_WS_Status To_VL_WS_Status(int soapError, int responseCode, const char* operation);

  // ---- Record conversion (VLUtilities_Convert.cpp) --------------------------------------------
  //
  // Copies of the store's schema records into client records, which own their copies and outlive
  // the call's SOAP memory. The client record must have been prepared with VLRecordInit (nested
  // arrays included) and hold nothing yet. Each converter asserts that t is given ("t != 0").
  // Rules: numbers and enumeration values as they are, schema booleans as 0 or 1; texts through
  // StrDup (a missing text becomes an owned empty one); arrays only when the schema array is
  // present and has elements, each element with its own tag cell; a product's ExpireDate
  // (an XML schema date-time) re-formatted as "YYYY/MM/DD hh:mm:ss", all zeros when missing or
  // unreadable.

  static void VL1__StandardResponse2VL_WS_StandardResponse(const VL1__StandardResponse* t,
                                                           VL_WS_StandardResponse& r);
  static void VL1__TitleListing2VL_WS_TitleListing(const VL1__TitleListing* t,
                                                   VL_WS_TitleListing& r);
  static void VL1__ArrayOfTitleListing2VL_WS_TitleListingArray(const VL1__ArrayOfTitleListing* t,
                                                               VL_WS_TitleListingArray& r);
  // The detail fields and the title fields; the wishlist flag of the answer is not kept.
  static void VL1__TitleListingResponse2VL_WS_TitleListingResponse(
      const VL1__TitleListingResponse* t, VL_WS_TitleListingResponse& r);
  static void VL1__ArrayOfTitleListingResponse2VL_WS_TitleListingResponseArray(
      const VL1__ArrayOfTitleListingResponse* t, VL_WS_TitleListingResponseArray& r);
  static void VL1__GetTitlesResponse2VL_WS_TitlesResponse(const VL1__GetTitlesResponse* t,
                                                          VL_WS_TitlesResponse& r);
  static void VL1__ArrayOfGetTitlesResponse2VL_WS_TitlesResponseArray(
      const VL1__ArrayOfGetTitlesResponse* t, VL_WS_TitlesResponseArray& r);
  static void VL1__RecommendedTitlesResponse2VL_WS_RecommendedTitlesResponse(
      const VL1__RecommendedTitlesResponse* t, VL_WS_RecommendedTitlesResponse& r);
  static void VL1__ArrayOfGenre2VL_WS_GenreArray(const VL1__ArrayOfGenre* t, VL_WS_GenreArray& r);
  static void VL1__GetGenreLabelResponse2VL_WS_GenreLabelResponse(const VL1__GetGenreLabelResponse* t,
                                                                 VL_WS_GenreLabelResponse& r);
  static void VL1__TvEpisodeList2VL_WS_TvEpisodeListResponse(const VL1__TvEpisodeList* t,
                                                             VL_WS_TvEpisodeListResponse& r);
  static void VL1__TranslateTivoExternalIDResponse2VL_WS_TranslateTivoExternalIDResponse(
      const VL1__TranslatedTivoExternalIdResponse* t, VL_WS_TranslateTivoExternalIDResponse& r);
  static void VL1__TranslateSkuIdResponse2VL_WS_TranslateSkuIDResponse(const VL1__TranslateSkuIdResponse* t,
                                                                       VL_WS_TranslateSkuIDResponse& r);
  // The purchase fields and the title fields.
  static void VL1__TitleListingPurchased2VL_WS_TitleListingPurchased(
      const VL1__TitleListingPurchased* t, VL_WS_TitleListingPurchased& r);
  static void VL1__GetMyVideosResponse2VL_WS_MyVideosResponse(const VL1__GetMyVideosResponse* t,
                                                              VL_WS_MyVideosResponse& r);
  static void VL1__GetWishlistItemsResponse2VL_WS_WishlistItemsResponse(
      const VL1__GetWishlistItemsResponse* t, VL_WS_WishlistItemsResponse& r);
  static void VL1__ArrayOfTitleListingPurchasedForPass2VL_WS_TitleListingPurchasedForPassArray(
      const VL1__ArrayOfTitleListingPurchasedForPass* t, VL_WS_TitleListingPurchasedForPassArray& r);
  // IsAdultVerificationEnabled is true when the answer's text is "true" in any letter case.
  static void VL1__AuthorizeDeviceResponse2VL_WS_AuthorizeDeviceResponse(
      const VL1__AuthorizeDeviceResponse* t, VL_WS_AuthorizeDeviceResponse& r);
  static void VL1__GetStreamingAssetLocationResponse2VL_WS_StreamingAssetLocationResponse(
      const VL1__GetStreamingAssetLocationResponse* t, VL_WS_StreamingAssetLocationResponse& r);
  static void VL1__THXMediaDirectorResponse2VL_WS_THXMediaDirectorResponse(
      const VL1__THXMediaDirectorResponse* t, VL_WS_THXMediaDirectorResponse& r);
  // The wishlist changes answer a code and a message outside the standard response type.
  static void VL1__WishListActionResponse2VL_WS_StandardResponse(const VL1__WishListActionResponse* t,
                                                                 VL_WS_StandardResponse& r);
  static void VL1__PurchaseResponse2VL_WS_PurchaseResponse(const VL1__PurchaseResponse* t,
                                                           VL_WS_PurchaseResponse& r);
  static void VL1__CalcOrderTaxResponse2VL_WS_OrderTaxResponse(const VL1__CalcOrderTaxResponse* t,
                                                               VL_WS_OrderTaxResponse& r);
  static void VL1__BillingInfoResponse2VL_WS_BillingInfoResponse(const VL1__BillingInfoResponse* t,
                                                                 VL_WS_BillingInfoResponse& r);
  static void VL1__PPCardBalanceResponse2VL_WS_PrePaidCardBalanceResponse(
      const VL1__PPCardBalanceResponse* t, VL_WS_PrePaidCardBalanceResponse& r);
  // Each part that the answer holds; a missing part stays empty.
  static void VL1__BillingInfoAndPPCBalanceResponse2VL_WS_BillingInfoAndPPCBalance(
      const VL1__BillingInfoAndPPCBalanceResponse* t, VL_WS_BillingInfoAndPPCBalance& r);
  static void VL1__GiftCertificateResponse2VL_WS_GiftCertificateResponse(
      const VL1__GiftCertificateResponse* t, VL_WS_GiftCertificateResponse& r);
  static void VL1__GetEmailAddressResponse2VL_WS_EmailAddressResponse(
      const VL1__GetEmailAddressResponse* t, VL_WS_EmailAddressResponse& r);
  static void VL1__SettingsPageInfo2VL_WS_SettingsPageResponse(const VL1__SettingsPageInfo* t,
                                                               VL_WS_SettingsPageResponse& r);
  // One item (Key, Value) per configuration element of the answer.
  static void VL1__GetConfigResponse2VL_WS_ConfigResponse(const VL1__GetConfigResponse* t,
                                                          VL_WS_ConfigResponse& r);
  // IsAdultVerificationEnabled as for the authorisation answer.
  static void VL1__CheckAdultVerificationEnabledResponse2VL_WS_AdultVerificationEnabledResponse(
      const VL1__CheckAdultVerificationEnabledResponse* t, VL_WS_AdultVerificationEnabledResponse& r);
  static void VL1__CheckAdultVerificationPinResponse2VL_WS_AdultVerificationPinResponse(
      const VL1__CheckAdultVerificationPinResponse* t, VL_WS_AdultVerificationPinResponse& r);
  static void VL1__CheckRentalExpirationResponse2VL_WS_RentalExpirationResponse(
      const VL1__CheckRentalExpirationResponse* t, VL_WS_RentalExpirationResponse& r);

  // ---- Box art and images (VLUtilities_BoxArt.cpp) --------------------------------------------

  // The size word of an image size in the URL's folder ("135s" for VL_WS_BOXART_135S) and in the
  // image's name ("135"); the empty text for a value that is not a size.
  static const char* BoxArtSize2FolderSize(VL_WS_BoxArtSize size);
  static const char* BoxArtSize2ImageSize(VL_WS_BoxArtSize size);
  // The cache file of an image: the folder of the cache database at path, then the box-art prefix
  // as it is (not URL-encoded), the image word and ".jpg". Asserts that both texts are given.
  static VLString GetBoxArtImageFileName(const char* path, const char* boxartprefix,
                                         VL_WS_BoxArtSize size);
  // Where the image host serves an image: the path "/images/boxart/<folder word>/<prefix><image
  // word>.jpg" with the prefix URL-encoded, and the absolute URL "http://<image host><path>".
  static VLString GetBoxArtImagePath(const char* boxartprefix, VL_WS_BoxArtSize size);
  static VLString GetBoxArtImageURL(const char* boxartprefix, VL_WS_BoxArtSize size);
  // Whether bytes, or the whole content of a file, can be a complete JPEG image: they begin with
  // its start-of-image marker and end with its end-of-image marker. Box art is kept and answered
  // from the cache only when it is one, so that an error page, a compressed or a cut body never
  // passes for the image.
  static bool IsJpegImage(const VLString& bytes);
  static bool IsJpegFile(const VLString& filename);
  // Gives an image record (kind 0) its own copy of data's bytes, releasing bytes it held; empty
  // data leaves it without bytes (null, length 0).
  static void SetImageByData(VL_WS_Image& image, const VLString& data);
  // Gives an image record the whole content of a file. The record is emptied first (kind 0, no
  // bytes, releasing bytes it held); false, with the record left empty, when the file cannot be
  // opened, is empty, or cannot be read whole.
  static bool SetImageByFile(VL_WS_Image& image, const VLString& filename);

  // ---- Endpoint query (VLUtilities_Endpoint.cpp) ----------------------------------------------

  // The base URL of the store's services (https, ending in "/") for a content type (ADULT, or
  // general for any other value) and an environment number. Environments 0 to 2 come from the
  // endpoint table and set envID to that number. Any other number asks the store's
  // device-environment service over the context's transport (its TLS context must be set up):
  // envID becomes the digit it answered, or 2 (production) for an answer that is not
  // "HTTP/1.1 200 OK" with "Content-Length: 1" and one digit, a failed exchange included. Returns
  // the empty text, envID unchanged, when the service could not be connected to.
  static const char* QueryServiceBaseURL(enum VL_WS_SetupParams::ContentType contentType, soap* context,
                                         const char* destinationUniqueID, int destinationTypeID,
                                         VL_WS_EnvNum envNum, VL_WS_EnvID& envID);
};

#endif  // VLUTILITIES_H
