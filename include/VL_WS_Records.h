/*
 * VL_WS_Records.h: the status values of the flat client interface VL_WS_ and every record that
 * the interface fills for its callers.
 *
 * Records
 * -------
 * Every record begins with `tag`, a pointer to a heap cell holding the record's type tag (one of
 * VL_WS_RecordTag). The operation that fills a record clears it and tags it before anything else,
 * so a record is always safe to hand to VL_WS_release, even after a failed call. Records that hold
 * other records (arrays, nested responses) give each of those its own tag cell.
 *
 * A filled record owns its texts and arrays: texts are never null (a missing text is an owned
 * empty one), arrays carry their element count beside the pointer (count 0 and a null pointer when
 * the answer had no elements). Give the whole record back with VL_WS_release, exactly once per
 * record; a second release finds a null tag pointer and does nothing. Never free parts of a record
 * yourself and never release an element of an array on its own.
 *
 * A record that extends another one (the "base") repeats the base's fields first, right after the
 * tag: every response derived from VL_WS_StandardResponse starts with ResponseCode and
 * ResponseMessage. In C++ the extension is written as inheritance, so the base's fields are read
 * directly and a pointer to the record converts to a pointer to its base.
 *
 * Field names are those of the store's schema. Enumerated values (file profile, audio profile,
 * purchase type, title type, stream status, watch status, ...) are passed as the store's numbers.
 */
#ifndef VL_WS_RECORDS_H
#define VL_WS_RECORDS_H

#include "VL_WS_Types.h"

/* --------------------------------------------------------------------------------------------
 * Status values
 *
 * 0 is success, every failure is negative. The numbers are part of the interface: the script
 * layer passes them to the movie unchanged.
 * ------------------------------------------------------------------------------------------ */
enum VL_WS_StatusCode {
  VL_WS_OK = 0,

  /* A required argument is missing or empty, the handle has no client state, or a record carries
   * an unknown type tag. */
  VL_WS_E_INVALID_ARGUMENT = -1000,
  /* A local network step failed: host name not resolved, socket not created or connected, a send
   * failed or nothing was received, or an HTTP answer did not have the expected form. */
  VL_WS_E_NETWORK = -1001,
  /* Unexpected result: a response code without a mapping for the operation, a SOAP error without a
   * code of its own, an answer that could not be read. */
  VL_WS_E_UNEXPECTED = -1004,

  /* VL_WS_authorizeDevice answered response code 1 or 2. */
  VL_WS_E_AUTHORIZE_1 = -1005,
  VL_WS_E_AUTHORIZE_2 = -1006,

  /* VL_WS_doPurchaseSavedBilling answered response code n: -1006 - n for n from 1 to 12, then
   * the codes 20, 21 and 22. */
  VL_WS_E_PURCHASE_1 = -1007,
  VL_WS_E_PURCHASE_2 = -1008,
  VL_WS_E_PURCHASE_3 = -1009,
  VL_WS_E_PURCHASE_4 = -1010,
  VL_WS_E_PURCHASE_5 = -1011,
  VL_WS_E_PURCHASE_6 = -1012,
  VL_WS_E_PURCHASE_7 = -1013,
  VL_WS_E_PURCHASE_8 = -1014,
  VL_WS_E_PURCHASE_9 = -1015,
  VL_WS_E_PURCHASE_10 = -1016,
  VL_WS_E_PURCHASE_11 = -1017,
  VL_WS_E_PURCHASE_12 = -1018,
  VL_WS_E_PURCHASE_20 = -1028,
  VL_WS_E_PURCHASE_21 = -1021,
  VL_WS_E_PURCHASE_22 = -1022,

  /* VL_WS_getBillingInfo answered response code 1 to 4; these share their numbers with purchase
   * codes 2, 11, 5 and 6. */
  VL_WS_E_BILLING_INFO_1 = -1008,
  VL_WS_E_BILLING_INFO_2 = -1017,
  VL_WS_E_BILLING_INFO_3 = -1011,
  VL_WS_E_BILLING_INFO_4 = -1012,

  /* VL_WS_assignGiftCertificateToUser answered response code 1 or 2. */
  VL_WS_E_GIFT_CERTIFICATE_1 = -1019,
  VL_WS_E_GIFT_CERTIFICATE_2 = -1020,

  /* VL_WS_calcOrderTax answered response code 1, 2, 3, 11, 12 or 20 (20 shares its number with
   * purchase code 20). */
  VL_WS_E_ORDER_TAX_1 = -1023,
  VL_WS_E_ORDER_TAX_2 = -1024,
  VL_WS_E_ORDER_TAX_3 = -1025,
  VL_WS_E_ORDER_TAX_11 = -1026,
  VL_WS_E_ORDER_TAX_12 = -1027,
  VL_WS_E_ORDER_TAX_20 = -1028,

  /* A local file operation failed. */
  VL_WS_E_FILE = -1900,
  /* An HTTP server answered "404 Not Found" (bandwidth probe, box-art download). */
  VL_WS_E_HTTP_NOT_FOUND = -1901,
  /* The image server answered "304 Not Modified" to a revalidation: the stored image is current. */
  VL_WS_E_HTTP_NOT_MODIFIED = -1902,
  /* Configuration file: empty, holds no settings, or has no setting with the key. */
  VL_WS_E_SETTING_MISSING = -1906,
  /* Configuration file: an encrypted value is damaged. */
  VL_WS_E_SETTING_DAMAGED = -1907,
  /* Configuration file: the file cannot be read as a settings file (cut short, garbage). */
  VL_WS_E_SETTING_UNREADABLE = -1908,
  /* The cache database could not be opened. */
  VL_WS_E_CACHE_OPEN = -1910,
  /* The cache folder does not exist and cannot be created. */
  VL_WS_E_CACHE_FOLDER = -1911,
  /* Bandwidth check: no probe URL is configured. */
  VL_WS_E_BANDWIDTH_NO_URL = -1920,
  /* Bandwidth check: the probe URL has no host or no path. */
  VL_WS_E_BANDWIDTH_BAD_URL = -1921,
  /* The TCP connection failed; at initialisation also: no service endpoint could be found. */
  VL_WS_E_CONNECT = -2011,
  /* The connection ended before the answer was complete. */
  VL_WS_E_EOF = -2012,
  /* HTTP-level failure n is reported as VL_WS_E_HTTP - n (see VL_WS_E_HTTP_STATUS). */
  VL_WS_E_HTTP = -4000,
  /* TLS certificate set-up of a service object failed. */
  VL_WS_E_TLS_SETUP = -5000,
  /* TLS failure during a call. */
  VL_WS_E_TLS = -5030,
  /* SOAP protocol failure n is reported as VL_WS_E_SOAP - n (see VL_WS_E_SOAP_FAULT). */
  VL_WS_E_SOAP = -6000
};

/* HTTP-level failures: an HTTP status n from 100 to 599 gives -4000 - n (an answer "503 Service
 * Unavailable" gives -4503, an HTTP 200 answer without a readable body -4200); the SOAP runtime's
 * HTTP errors 14 (no data), 15 to 19 (unsupported HTTP method) and 29 (HTTP error) give -4014 to
 * -4019 and -4029. */
#define VL_WS_E_HTTP_STATUS(n) (VL_WS_E_HTTP - (n))

/* SOAP protocol failures: the SOAP runtime's error n gives -6000 - n for n = 1 (client fault),
 * 2 (server fault), 3 (tag mismatch), 5 (syntax error), 6 (no tag), 8 (mustUnderstand),
 * 9 (namespace), 12 (fault), 13 (no method), 23 (null), 24 (duplicate id), 25 (missing id),
 * 26 (href), 39 (version mismatch), 42 (required), 43 (prohibited), 44 (occurs), 45 (length).
 * A SOAP fault of the server therefore gives -6002. Other runtime errors give VL_WS_E_UNEXPECTED. */
#define VL_WS_E_SOAP_FAULT(n) (VL_WS_E_SOAP - (n))

/* --------------------------------------------------------------------------------------------
 * Type tags
 * ------------------------------------------------------------------------------------------ */
enum VL_WS_RecordTag {
  VL_WS_TAG_NONE = 0,                        /* no contents: only the cell is freed */
  VL_WS_TAG_HANDLE = 1,                      /* VL_WS_Handle (VL_WS_Types.h) */
  VL_WS_TAG_STRING = 2,                      /* VL_WS_String */
  VL_WS_TAG_STANDARD_RESPONSE = 3,           /* VL_WS_StandardResponse */
  VL_WS_TAG_GENRE = 4,                       /* VL_WS_Genre */
  VL_WS_TAG_GENRE_ARRAY = 5,                 /* VL_WS_GenreArray */
  VL_WS_TAG_GENRE_LABEL_RESPONSE = 6,        /* VL_WS_GenreLabelResponse */
  VL_WS_TAG_BONUS_ASSET = 7,                 /* VL_WS_BonusAsset */
  VL_WS_TAG_BONUS_ASSET_ARRAY = 8,           /* VL_WS_BonusAssetArray */
  VL_WS_TAG_INT_ARRAY = 9,                   /* VL_WS_IntArray */
  VL_WS_TAG_AUDIO_FILE_ARRAY = 10,           /* VL_WS_AudioFileArray */
  VL_WS_TAG_AUDIO_FILE = 11,                 /* VL_WS_AudioFile */
  VL_WS_TAG_PRODUCT_LISTING = 12,            /* VL_WS_ProductListing */
  VL_WS_TAG_PRODUCT_LISTING_ARRAY = 13,      /* VL_WS_ProductListingArray */
  VL_WS_TAG_TITLE_LISTING = 14,              /* VL_WS_TitleListing */
  VL_WS_TAG_TITLE_LISTING_ARRAY = 15,        /* VL_WS_TitleListingArray */
  VL_WS_TAG_TITLE_LISTING_RESPONSE = 16,     /* VL_WS_TitleListingResponse */
  VL_WS_TAG_TITLE_LISTING_RESPONSE_ARRAY = 17, /* VL_WS_TitleListingResponseArray */
  VL_WS_TAG_TITLES_RESPONSE = 18,            /* VL_WS_TitlesResponse */
  VL_WS_TAG_TITLES_RESPONSE_ARRAY = 19,      /* VL_WS_TitlesResponseArray */
  VL_WS_TAG_TV_EPISODE = 20,                 /* VL_WS_TvEpisode */
  VL_WS_TAG_TV_EPISODE_ARRAY = 21,           /* VL_WS_TvEpisodeArray */
  VL_WS_TAG_TV_EPISODE_LIST_RESPONSE = 22,   /* VL_WS_TvEpisodeListResponse */
  VL_WS_TAG_AUTHORIZE_DEVICE_RESPONSE = 23,  /* VL_WS_AuthorizeDeviceResponse */
  VL_WS_TAG_TITLE_LISTING_PURCHASED = 24,    /* VL_WS_TitleListingPurchased */
  VL_WS_TAG_TITLE_LISTING_PURCHASED_ARRAY = 25, /* VL_WS_TitleListingPurchasedArray */
  VL_WS_TAG_MY_VIDEOS_RESPONSE = 26,         /* VL_WS_MyVideosResponse */
  VL_WS_TAG_WISHLIST_ITEMS_RESPONSE = 27,    /* VL_WS_WishlistItemsResponse */
  VL_WS_TAG_GIFT_CERTIFICATE_RESPONSE = 28,  /* VL_WS_GiftCertificateResponse */
  VL_WS_TAG_ADULT_VERIFICATION_ENABLED_RESPONSE = 29, /* VL_WS_AdultVerificationEnabledResponse */
  VL_WS_TAG_ADULT_VERIFICATION_PIN_RESPONSE = 30,     /* VL_WS_AdultVerificationPinResponse */
  VL_WS_TAG_PURCHASE_RESPONSE = 31,          /* VL_WS_PurchaseResponse */
  VL_WS_TAG_STREAMING_ASSET_LOCATION_RESPONSE = 32, /* VL_WS_StreamingAssetLocationResponse */
  VL_WS_TAG_PREPAID_CARD_BALANCE_RESPONSE = 33,     /* VL_WS_PrePaidCardBalanceResponse */
  VL_WS_TAG_CONFIGURATION_ITEM = 34,         /* VL_WS_ConfigurationItem */
  VL_WS_TAG_CONFIG_RESPONSE = 35,            /* VL_WS_ConfigResponse */
  VL_WS_TAG_BILLING_INFO_RESPONSE = 36,      /* VL_WS_BillingInfoResponse */
  VL_WS_TAG_BILLING_INFO_AND_PPC_BALANCE = 37, /* VL_WS_BillingInfoAndPPCBalance */
  VL_WS_TAG_SETTINGS_PAGE_RESPONSE = 38,     /* VL_WS_SettingsPageResponse */
  VL_WS_TAG_EMAIL_ADDRESS_RESPONSE = 39,     /* VL_WS_EmailAddressResponse */
  VL_WS_TAG_RECOMMENDED_TITLES_RESPONSE = 40, /* VL_WS_RecommendedTitlesResponse */
  VL_WS_TAG_ORDER_TAX_RESPONSE = 41,         /* VL_WS_OrderTaxResponse */
  VL_WS_TAG_RENTAL_EXPIRATION_RESPONSE = 42, /* VL_WS_RentalExpirationResponse */
  VL_WS_TAG_TITLE_LISTING_PURCHASED_FOR_PASS = 43,       /* VL_WS_TitleListingPurchasedForPass */
  VL_WS_TAG_TITLE_LISTING_PURCHASED_FOR_PASS_ARRAY = 44, /* VL_WS_TitleListingPurchasedForPassArray */
  /* 45 to 48 are reserved: no operation produces them and VL_WS_release refuses them. */
  VL_WS_TAG_FILE_TYPE = 49,                  /* VL_WS_FileType */
  VL_WS_TAG_VERSION = 50,                    /* VL_WS_Version */
  VL_WS_TAG_BOOL_ARRAY = 51,                 /* VL_WS_BoolArray */
  VL_WS_TAG_IMAGE = 52,                      /* VL_WS_Image */
  VL_WS_TAG_TRANSLATE_TIVO_EXTERNAL_ID_RESPONSE = 53, /* VL_WS_TranslateTivoExternalIDResponse */
  VL_WS_TAG_TRANSLATE_SKU_ID_RESPONSE = 54,  /* VL_WS_TranslateSkuIDResponse */
  VL_WS_TAG_THX_MEDIA_DIRECTOR_RESPONSE = 55, /* VL_WS_THXMediaDirectorResponse */

  VL_WS_TAG_LAST = 55                        /* the highest tag */
};

/* --------------------------------------------------------------------------------------------
 * Basic records
 * ------------------------------------------------------------------------------------------ */

/* A text result (tag 2): string operations, local address, box-art file name or URL, ... */
struct VL_WS_String {
  int* tag;
  int Length; /* bytes of Text, without the terminator */
  char* Text;
};

/* The answer of operations that only report a result (tag 3), and the first two fields of every
 * response derived from it. ResponseCode 0 is the store's success; the other codes are passed
 * through as the store sent them. */
struct VL_WS_StandardResponse {
  int* tag;
  int ResponseCode;
  char* ResponseMessage;
};

/* A list of plain numbers (tag 9): the file profiles available for a product. */
struct VL_WS_IntArray {
  int* tag;
  int Count;
  int* Items;
};

/* One flag per title asked for (tag 51): VL_WS_checkTitlesInWishlist, in the order of the IDs. */
struct VL_WS_BoolArray {
  int* tag;
  int Count;
  bool* Items;
};

/* The version of this interface (tag 50): 1.3.1, most significant part first. */
struct VL_WS_Version {
  int* tag;
  int Major;
  int Minor;
  int Revision;
};

/* One entry of the environment list: an environment number (VL_WS_EnvNum) and its name. */
struct VL_WS_EnvListEntry {
  int EnvNum;
  const char* Name;
};

/* The environment list of VL_WS_getAvailableEnvLists. It has no type tag and owns nothing: the
 * entries are a static table of the library; never release this record. */
struct VL_WS_EnvList {
  int Count;
  const VL_WS_EnvListEntry* Entries;
};

/* A box-art image (tag 52): the image's bytes, owned by the record. */
struct VL_WS_Image {
  int* tag;
  int Kind;   /* 0: JPEG bytes */
  int Length; /* byte count of Data */
  char* Data; /* null when Length is 0 */
};

/* --------------------------------------------------------------------------------------------
 * Catalogue: genres
 * ------------------------------------------------------------------------------------------ */

/* One genre of the navigation tree (tag 4). */
struct VL_WS_Genre {
  int* tag;
  int ID;
  char* Name;
  bool Visible;
  int ParentId; /* ID of the parent genre */
};

/* The genre tree as a flat list (tag 5): VL_WS_getNavigation. */
struct VL_WS_GenreArray {
  int* tag;
  int Count;
  VL_WS_Genre* Items;
};

/* A genre's label (tag 6): VL_WS_getGenreLabel. */
struct VL_WS_GenreLabelResponse : VL_WS_StandardResponse {
  char* Label;
  char* LabelMessage;
};

/* --------------------------------------------------------------------------------------------
 * Catalogue: titles and products
 * ------------------------------------------------------------------------------------------ */

/* A bonus asset of a title, such as a trailer (tag 7). */
struct VL_WS_BonusAsset {
  int* tag;
  int BonusAssetID;
  int Profile;   /* file profile */
  int BonusType; /* bonus asset type: 0 trailer */
};

/* The bonus assets of a title (tag 8). */
struct VL_WS_BonusAssetArray {
  int* tag;
  int Count;
  VL_WS_BonusAsset* Items;
};

/* An audio track of a product (tag 11). */
struct VL_WS_AudioFile {
  int* tag;
  int AssetAudioID;
  char* FileLocation;
  bool ContainsVideo;
  int AudioAssetProfile; /* audio profile */
};

/* The audio tracks of a product (tag 10). */
struct VL_WS_AudioFileArray {
  int* tag;
  int Count;
  VL_WS_AudioFile* Items;
};

/* One way to buy or rent a title (tag 12). */
struct VL_WS_ProductListing {
  int* tag;
  int SkuID;
  int PurchaseType;                          /* 0 rent, 1 buy, 2 any */
  char* Price;                               /* the decimal exactly as the store sent it */
  VL_WS_IntArray AvailableAssets;            /* file profiles */
  char* ExpireDate;                          /* "YYYY/MM/DD hh:mm:ss"; all zeros when unknown */
  VL_WS_AudioFileArray AvailableAudioProfiles;
  int RentalPeriod;
};

/* The products of a title (tag 13). */
struct VL_WS_ProductListingArray {
  int* tag;
  int Count;
  VL_WS_ProductListing* Items;
};

/* A title as it appears on pages and lists (tag 14), and the first fields of every title record
 * derived from it. */
struct VL_WS_TitleListing {
  int* tag;
  int TitleID;
  char* TitleName;
  char* BoxArtPrefix; /* names the title's box-art images (VL_WS_getBoxArtImage) */
  int TitlePosition;
  int EpisodeNumber;
  VL_WS_BonusAssetArray BonusAssets;
  bool IsTvListing;
  char* MPAARating;
  VL_WS_ProductListingArray AvailableProducts;
  bool IsTHXMediaDirectorEnabled;
  bool IsTHXMediaDirectorEnabledForTrailer;
  char* CHVRSRating;
  char* LoyaltyPointsForBuy;
  char* LoyaltyPointsForRent;
};

/* A list of titles (tag 15). */
struct VL_WS_TitleListingArray {
  int* tag;
  int Count;
  VL_WS_TitleListing* Items;
};

/* The details of one title or episode (tag 16): VL_WS_getTitleListing,
 * VL_WS_getTvEpisodeListing. */
struct VL_WS_TitleListingResponse : VL_WS_TitleListing {
  int ResponseCode;
  char* ResponseMessage;
  char* Synopsys;
  int UserRating;
  char* Directors;
  char* Actors;
  char* Writers;
  char* Producers;
  char* Copyright;
  char* RunTime;
  char* RatingReason;
};

/* The details of every episode of a series (tag 17): VL_WS_getAllTvEpisodeListings. */
struct VL_WS_TitleListingResponseArray {
  int* tag;
  int Count;
  VL_WS_TitleListingResponse* Items;
};

/* One page of titles (tag 18): VL_WS_getTitles, VL_WS_searchForTitle,
 * VL_WS_searchForTitleDetail. */
struct VL_WS_TitlesResponse : VL_WS_StandardResponse {
  int GenreID;
  short CurrentPageNumber;
  short ItemsPerPage;
  short TotalPages;
  short TotalItems;
  VL_WS_TitleListingArray Titles;
};

/* One page per genre asked for (tag 19): VL_WS_getTitlesByGenreIDs. */
struct VL_WS_TitlesResponseArray {
  int* tag;
  int Count;
  VL_WS_TitlesResponse* Items;
};

/* Titles recommended with a title (tag 40): VL_WS_getRecommendedTitles. */
struct VL_WS_RecommendedTitlesResponse : VL_WS_StandardResponse {
  VL_WS_TitleListingArray Titles;
};

/* --------------------------------------------------------------------------------------------
 * Catalogue: television episodes and identifiers
 * ------------------------------------------------------------------------------------------ */

/* One episode of a series (tag 20). */
struct VL_WS_TvEpisode {
  int* tag;
  int EpisodeID;
  char* EpisodeName;
  int EpisodeNumber;
};

/* The episodes of a series (tag 21). */
struct VL_WS_TvEpisodeArray {
  int* tag;
  int Count;
  VL_WS_TvEpisode* Items;
};

/* The episode list of a series (tag 22): VL_WS_getTvEpisodeListByTitleID. */
struct VL_WS_TvEpisodeListResponse : VL_WS_StandardResponse {
  VL_WS_TvEpisodeArray Episodes;
};

/* The title of a TiVo identifier (tag 53): VL_WS_translateTivoExternalID. */
struct VL_WS_TranslateTivoExternalIDResponse : VL_WS_StandardResponse {
  char* TivoExternalId;
  int TitleId;
};

/* The title of a SKU (tag 54): VL_WS_translateSkuID. */
struct VL_WS_TranslateSkuIDResponse : VL_WS_StandardResponse {
  int TitleId;
};

/* --------------------------------------------------------------------------------------------
 * Account and purchases
 * ------------------------------------------------------------------------------------------ */

/* The result of linking the device to an account (tag 23): VL_WS_authorizeDevice. Keep AuthToken
 * and pass it as VL_WS_SetupParams::AuthToken at the next initialisation. */
struct VL_WS_AuthorizeDeviceResponse : VL_WS_StandardResponse {
  char* AuthToken;
  char* EmailAddress;
  bool IsAdultVerificationEnabled;
  char* DeviceID;
  char* DeviceName;
};

/* A title the account has bought or rented (tag 24). */
struct VL_WS_TitleListingPurchased : VL_WS_TitleListing {
  int EpisodeID;
  int TvListingTitleID;
  int PurchaseType;  /* 0 rent, 1 buy */
  int Status;        /* watch status: 0 watch now, 1 rent again, 2 not available, 3 undefined */
  char* RentalPeriod;
  int PassID;        /* the pass that streaming operations take */
  int PlayStatus;    /* stream status: 0 play, 1 stopped, 2 paused, 3 resume play, 4 error */
  int StartTimeSeconds;
};

/* A list of purchased titles (tag 25). */
struct VL_WS_TitleListingPurchasedArray {
  int* tag;
  int Count;
  VL_WS_TitleListingPurchased* Items;
};

/* One page of the account's videos (tag 26): VL_WS_getMyVideos. */
struct VL_WS_MyVideosResponse : VL_WS_StandardResponse {
  short CurrentPageNumber;
  short ItemsPerPage;
  short TotalPages;
  short TotalItems;
  VL_WS_TitleListingPurchasedArray Titles;
};

/* One page of the wishlist (tag 27): VL_WS_getWishlistItems. */
struct VL_WS_WishlistItemsResponse : VL_WS_MyVideosResponse {
  int SortOrder;
};

/* A purchased title of a pass with the store's result for that pass (tag 43). */
struct VL_WS_TitleListingPurchasedForPass : VL_WS_TitleListingPurchased {
  int ResponseCode;
  char* ResponseMessage;
};

/* The titles of the passes asked for (tag 44): VL_WS_getTitleListingPurchaseds. */
struct VL_WS_TitleListingPurchasedForPassArray {
  int* tag;
  int Count;
  VL_WS_TitleListingPurchasedForPass* Items;
};

/* The result of a purchase with saved billing data (tag 31): VL_WS_doPurchaseSavedBilling. */
struct VL_WS_PurchaseResponse : VL_WS_StandardResponse {
  int PassID;
  int TransactionId;
  char* TransactionAuthNum;
};

/* The tax of an order (tag 41): VL_WS_calcOrderTax. The amounts are decimals as the store sent
 * them. */
struct VL_WS_OrderTaxResponse : VL_WS_StandardResponse {
  char* SubTotal;
  char* TotalPrice;
  char* Tax;
};

/* The balance after redeeming a gift certificate (tag 28): VL_WS_assignGiftCertificateToUser. */
struct VL_WS_GiftCertificateResponse : VL_WS_StandardResponse {
  int Balance;
};

/* The balance of the account's prepaid card (tag 33): VL_WS_getPrePaidCardBalance. */
struct VL_WS_PrePaidCardBalanceResponse : VL_WS_StandardResponse {
  int Balance;
};

/* The account's saved credit card (tag 36): VL_WS_getBillingInfo. */
struct VL_WS_BillingInfoResponse : VL_WS_StandardResponse {
  char* CCLastFour;
  int CCTypeId;
  char* CCType;
};

/* Billing data and prepaid balance in one answer (tag 37): VL_WS_getBillingInfoAndPPCBalance. */
struct VL_WS_BillingInfoAndPPCBalance {
  int* tag;
  VL_WS_BillingInfoResponse BillingInfo;
  VL_WS_PrePaidCardBalanceResponse PPCardBalance;
};

/* Whether adult content needs the PIN (tag 29): VL_WS_checkAdultVerificationEnabled. */
struct VL_WS_AdultVerificationEnabledResponse : VL_WS_StandardResponse {
  bool IsAdultVerificationEnabled;
};

/* Whether the adult-content PIN was right (tag 30): VL_WS_checkAdultVerificationPin. */
struct VL_WS_AdultVerificationPinResponse : VL_WS_StandardResponse {
  bool IsPinVerified;
};

/* Whether to warn that a rental runs out (tag 42): VL_WS_checkRentalExpiration. */
struct VL_WS_RentalExpirationResponse : VL_WS_StandardResponse {
  bool ShouldDisplay;
  int HoursRemaining;
};

/* The account's e-mail address (tag 39): VL_WS_getEmailAddress. */
struct VL_WS_EmailAddressResponse : VL_WS_StandardResponse {
  char* EmailAddress;
};

/* The account page of the device (tag 38): VL_WS_getSettingsPageInfo. */
struct VL_WS_SettingsPageResponse : VL_WS_StandardResponse {
  char* Account;
  char* DeviceID;
  char* DeviceName;
};

/* One setting of the store's configuration (tag 34). */
struct VL_WS_ConfigurationItem {
  int* tag;
  char* Key;
  char* Value;
};

/* The store's configuration for the device (tag 35): VL_WS_getConfig. */
struct VL_WS_ConfigResponse : VL_WS_StandardResponse {
  int Count;
  VL_WS_ConfigurationItem* Items;
};

/* How the device gets its titles (tag 49): VL_WS_getFileType. Each field is the store's number of
 * its enumeration; File_AccessType is a VL_WS_AccessType. */
struct VL_WS_FileType {
  int* tag;
  int File_DRMProvider;
  int File_AccessType;
  int File_FileProfile;
  int File_VideoFormat;
  int File_FileExtension;
};

/* --------------------------------------------------------------------------------------------
 * Streaming
 * ------------------------------------------------------------------------------------------ */

/* Where and how to play a stream (tag 32): VL_WS_getStreamingAssetLocation,
 * VL_WS_getStreamingBonusAssetLocation, VL_WS_loadLastStreamingAssetLocation. */
struct VL_WS_StreamingAssetLocationResponse : VL_WS_StandardResponse {
  char* StreamingAssetLocation; /* the stream's URL */
  int AssetID;
  char* StreamID;               /* this stream instance, for VL_WS_manageStreamingInstanceStatus */
  char* DRMServerURL;
  char* DRMACKServerURL;
  int Status;                   /* stream status: 0 play, 1 stopped, 2 paused, 3 resume play, 4 error */
  int StartTimeSeconds;         /* where playback resumes */
  char* HeartbeatURL;
  int HeartbeatPollInSeconds;
};

/* THX media director settings of a title or bonus asset (tag 55): VL_WS_getTHXMediaDirector,
 * VL_WS_getTHXMediaDirectorBonusAsset. */
struct VL_WS_THXMediaDirectorResponse : VL_WS_StandardResponse {
  char* LongFormat;
  char* ShortFormat;
};

#endif /* VL_WS_RECORDS_H */
