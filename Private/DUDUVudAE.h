// DUDUVudAE: the native side of the script class "com.ostrel.DUDUVud", through which the movie
// reaches the store's web services. Every method has the common extension method signature and
// writes its immediate result into its last argument.
//
// A store method checks its arguments, copies them into a parameter record and runs one worker
// thread that calls the matching VL_WS_ operation on the instance's main client; it answers at
// once with one of the immediate codes below. The worker leaves the operation's status and
// out-value in the instance's Result and raises the result-ready flag; the engine's next
// OnUpdate turns the out-value into a script value (DUDUVud::SetResult) and calls the movie's
// "onComplete"(status, result). An instance serves one request at a time.
//
// Immediate codes: 0 accepted (or done, for the synchronous methods), -1 not initialised,
// -2 a request is still in progress, -3 wrong arguments, -4 already initialised, -5 a client
// query failed (clone, getDeviceEnv, getAvailableEnvLists).
//
// Threads: methods, OnUpdate and DestructInstance run on the engine's thread; a worker touches
// only its record, the main client and the Result until it publishes the result. An object that
// the movie drops while one of its threads runs is deleted off the engine's thread once that
// thread is done (JoinDroppedInstances waits for those deletions).
#ifndef DUDUVUDAE_H
#define DUDUVUDAE_H

#include <atomic>

#include "AEArray.h"
#include "AEString.h"
#include "ASExtensionClass.h"
#include "IAEKernel.h"
#include "VLThread.h"
#include "VL_WS.h"
#include "VL_WS_SetupParams2.h"

class DUDUVudAE : public ae::stagecraft::ASExtensionClass {
 public:
  // The class functions that register the class with the stage.
  static const char* GetClassName();
  static bool FiresEvents();
  // Appends the 59 method entries, in table order, at the end of table.
  static void GetMethods(AEArray<Method>& table);
  static ae::stagecraft::ASExtensionClass* ConstructInstance(StageWindow* window, ASObject& object,
                                                             ASValueArray& arguments);
  // Gives up the object's callback at once; the native instance is deleted at once too, unless
  // one of its threads still runs: then it is deleted off the engine's thread when that is done.
  static void DestructInstance(StageWindow* window, ASObject& object);
  // Returns once every instance dropped while a thread of it ran has been deleted.
  static void JoinDroppedInstances();

  // The kind of out-value a worker leaves in the Result (0: nothing pending).
  enum Result_Type : int {
    RESULT_NONE = 0,
    RESULT_INT = 1,
    RESULT_BOOL = 2,
    RESULT_STRING = 3,
    RESULT_NAVIGATION = 4,
    RESULT_TITLES = 5,
    RESULT_TITLE_LISTING = 6,
    RESULT_AUTHORIZE_DEVICE = 7,
    RESULT_MY_VIDEOS = 8,
    RESULT_STANDARD = 9,
    RESULT_RECOMMENDED_TITLES = 10,
    RESULT_TRANSLATE_SKU_ID = 11,
    RESULT_TV_EPISODE_LIST = 12,
    RESULT_ALL_TV_EPISODE_LISTINGS = 13,
    RESULT_WISHLIST_ITEMS = 14,
    RESULT_PURCHASE = 15,
    RESULT_ADULT_VERIFICATION_ENABLED = 16,
    RESULT_ADULT_VERIFICATION_PIN = 17,
    RESULT_GIFT_CERTIFICATE = 18,
    RESULT_RENTAL_EXPIRATION = 19,
    RESULT_STREAMING_ASSET_LOCATION = 20,
    RESULT_EMAIL_ADDRESS = 21,
    RESULT_BILLING_INFO = 22,
    RESULT_PREPAID_CARD_BALANCE = 23,
    RESULT_CONFIG = 24,
    RESULT_SETTINGS_PAGE = 25,
    RESULT_FILE_TYPE = 26,
    RESULT_BOOL_ARRAY = 27,
    RESULT_ORDER_TAX = 28,
    RESULT_THX_MEDIA_DIRECTOR = 29
  };

  // The hand-over of a finished operation from the worker to completion delivery. The data is
  // the out-value of the operation, one member per kind; a record member is released by
  // SetResult once it is read (or by the instance when it is never delivered).
  struct Result {
    Result_Type type;
    union Data {
      int Int;
      bool Bool;
      VL_WS_String String;
      VL_WS_GenreArray Genres;
      VL_WS_TitlesResponse Titles;
      VL_WS_TitleListingResponse TitleListing;
      VL_WS_AuthorizeDeviceResponse Authorization;
      VL_WS_MyVideosResponse MyVideos;
      VL_WS_StandardResponse Standard;
      VL_WS_RecommendedTitlesResponse Recommended;
      VL_WS_TranslateSkuIDResponse SkuTranslation;
      VL_WS_TvEpisodeListResponse Episodes;
      VL_WS_TitleListingResponseArray AllEpisodes;
      VL_WS_WishlistItemsResponse Wishlist;
      VL_WS_PurchaseResponse Purchase;
      VL_WS_AdultVerificationEnabledResponse AdultVerification;
      VL_WS_AdultVerificationPinResponse AdultPin;
      VL_WS_GiftCertificateResponse GiftCertificate;
      VL_WS_RentalExpirationResponse RentalExpiration;
      VL_WS_StreamingAssetLocationResponse StreamLocation;
      VL_WS_EmailAddressResponse Email;
      VL_WS_BillingInfoResponse Billing;
      VL_WS_PrePaidCardBalanceResponse PrePaidBalance;
      VL_WS_ConfigResponse Config;
      VL_WS_SettingsPageResponse SettingsPage;
      VL_WS_FileType FileType;
      VL_WS_BoolArray Flags;
      VL_WS_OrderTaxResponse OrderTax;
      VL_WS_THXMediaDirectorResponse THX;
    } data;
    VL_WS_Status status;
  };

  // The record a worker gets: the owning instance, followed in the derived records by copies of
  // the script arguments. The worker owns it from the moment it runs and deletes it through
  // Finish.
  struct Param {
    explicit Param(DUDUVudAE* owner) : owner(owner) {}
    virtual ~Param() = default;

    VL_WS_Handle* Client() const { return &owner->m_Client; }
    Result::Data& Out() const { return owner->m_Result.data; }
    // Ends the worker: logs the operation's status, then publishes.
    void Finish(VL_WS_Status status);
    // Stores the status, deletes this record and hands the result to the engine's thread.
    void Publish(VL_WS_Status status);
    // After a successful change of account: the user-data prefetch client is made again from the
    // main client, once no prefetch thread uses it.
    void RenewUserDataClient(const char* logLine);
    // The init worker's last steps: initialised when status is 0, and then the prefetch clients.
    void FinishInit(VL_WS_Status status);

    DUDUVudAE* owner;
  };

  void init(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void clone(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void idle(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void quitFlash(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getUserAgent(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getDeviceEnv(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getSysInfo(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void trace(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void checkVLSWFmd5sum(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void fileExist(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void clearLocalCache(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getAvailableEnvLists(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void setLogAreaIDsAndTargetConfig(StageWindow* window, ASObject& object, ASValueArray& arguments,
                                    ASValue& result);
  // The asynchronous store methods: the I-th entry of the method table.
  template <int I>
  void StoreMethod(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);

  // Which pages of the current page query are in the cache, and which of its neighbours to fetch
  // next. Shared by the engine's thread and the page-prefetch thread under the prefetch lock.
  class PrefetchMgr {
   public:
    PrefetchMgr();
    void SetMutex(IAEKernel::Mutex* lock);
    // Records the query of a page result; when any part of it changed, the pages counted so far
    // and the waiting box art are forgotten.
    void Update(AEArray<AEString>& waiting, Result_Type type, unsigned totalPages, unsigned totalItems,
                unsigned itemsPerPage, int p1, int p2, int p3);
    void MarkPagePrefetched(unsigned page);
    // Whether page was counted (the caller holds the lock).
    bool IsPageAlreadyPrefetched(unsigned page) const;
    // Up to `wanted` pages around `current` that were not counted yet, alternately the next and
    // the previous ones, nearest first, wrapping around at both ends; `found` of them in pages.
    void GetPagesForPrefetch(unsigned current, unsigned wanted, unsigned* pages, unsigned& found);

   private:
    IAEKernel::Mutex* m_Lock;
    Result_Type m_Type;
    unsigned m_TotalPages;
    unsigned m_TotalItems;
    unsigned m_ItemsPerPage;
    int m_Query[3];
    AEArray<unsigned> m_Pages;
  };

  // Puts prefixes in front of the waiting box-art list (under the prefetch lock).
  void AddWaitingForDownloadBoxArts(const AEArray<AEString>& prefixes);
  // The new prefixes, then the waiting ones in their order while the list holds at most 50.
  static void MergeWaitingBoxArts(AEArray<AEString>& waiting, const AEArray<AEString>& prefixes);

  // The record of a prefetch thread (defined with the prefetch workers).
  struct PrefetchParam;

  void OnUpdate(StageWindow* window, ASObject& object) override;
  ~DUDUVudAE() override;

  // The method table, in table order: the 59 names with what each does.
  struct MethodEntry;
  static const MethodEntry s_Methods[];

 private:
  DUDUVudAE();

  // The store method family: checks, record, worker thread; the immediate code.
  int StartRequest(const MethodEntry& entry, ASObject& object, ASValueArray& arguments);
  // Starts the worker thread in the worker slot and asks for updates; when no thread can be
  // started, the request completes with VL_WS_E_UNEXPECTED instead.
  void RunThread(const char* name, void (*worker)(void*), Param* record, ASObject& object);
  // Takes the worker thread out of its slot, under the main lock.
  VLThread* TakeThread();
  // Waits for the thread in slot to end, then destroys it and clears the slot.
  void SafeDestroyThread(VLThread*& slot);
  // After a page result: counts the page and starts fetching its neighbours.
  void SchedulePrefetch();
  // While the movie is idle: starts the download of the first waiting box-art image.
  void StartBoxArtDownload();
  // Starts a prefetch thread: "prefetch_getTitles" in the page slot, any other in the box-art
  // slot.
  void RunPrefetchThread(const char* name, void (*worker)(void*), PrefetchParam* record);
  // Duplicates source into the prefetch clients that the cache type and selection ask for.
  void MakePrefetchClients(const VL_WS_Handle* source);
  // Whether a worker or prefetch thread of the instance still exists.
  bool HasThreads();
  // Clears the Result for a request whose worker will leave a value of type.
  void PrepareResult(Result_Type type);
  // Releases the out-record of a result that will not be delivered.
  void DiscardResult();

  Result m_Result;
  VL_WS_Handle m_Client;
  VL_WS_Handle m_CataloguePrefetchClient;
  VL_WS_Handle m_BoxArtPrefetchClient;
  VL_WS_Handle m_UserDataPrefetchClient;
  VLThread* m_Thread;
  VLThread* m_PagePrefetchThread;
  VLThread* m_BoxArtPrefetchThread;
  IAEKernel::Mutex* m_PrefetchLock;
  IAEKernel::Mutex* m_Lock;
  ASObject m_Callback;
  // Request parameters kept for prefetching.
  int m_SortOrder;
  int m_TypeFilter;
  int m_WatchStatus;
  int m_PurchaseType;
  int m_BoxArtSize;
  // Copies of the CacheType and CacheData given to init (or taken over by clone). Prefetching
  // works with a cache file (kFileCache) only.
  int m_CacheType;
  int m_CacheData;
  std::atomic<bool> m_Initialised;
  std::atomic<bool> m_ResultReady;
  bool m_PrefetchWanted;
  std::atomic<bool> m_PagePrefetchRunning;
  std::atomic<bool> m_BoxArtPrefetchRunning;
  bool m_IdleSeen;
  // The box-art prefixes waiting for download, under the prefetch lock.
  AEArray<AEString> m_WaitingBoxArts;
  PrefetchMgr m_Prefetch;
  // The method of the request in progress, for the worker's log line.
  const char* m_RequestName;
};

namespace DUDUVud {
// Fills value from result, building script values through the factories of object (the
// completion callback); releases the out-record of every type but 1 and 2. False, with value
// untouched, for an unknown result type.
bool SetResult(DUDUVudAE::Result& result, ae::stagecraft::ASValue& value, ae::stagecraft::ASObject& object);
}  // namespace DUDUVud

#endif  // DUDUVUDAE_H
