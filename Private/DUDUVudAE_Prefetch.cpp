// Prefetching of the web-service extension: after a page of titles, videos or wishlist items
// was shown, the neighbouring pages are fetched into the cache file on a thread of their own,
// and while the movie is idle the box art of the titles seen is downloaded, one image per update.
#include "DUDUVudAE.h"

#include <string.h>

#include <utility>

#include "VLAssert.h"
#include "VLWSAELog.h"

namespace {

VLLogArea s_Log(VLWSAELOG_AREA_NAME);

VLLogOutputConfig Trace() { return {s_Log.Id(), 4}; }

// How many pages around the one shown are fetched.
const unsigned kPagesWanted = 8;

// The waiting box-art list grows to a little over this size, the newest prefixes first.
const size_t kMaxWaitingBoxArts = 50;

// Holds a kernel mutex for a scope.
class Locked {
 public:
  explicit Locked(IAEKernel::Mutex* lock) : m_Lock(lock) { m_Lock->Lock(); }
  ~Locked() { m_Lock->Unlock(); }
  Locked(const Locked&) = delete;
  Locked& operator=(const Locked&) = delete;

 private:
  IAEKernel::Mutex* m_Lock;
};

}  // namespace

// --- PrefetchMgr ----------------------------------------------------------------------------------

DUDUVudAE::PrefetchMgr::PrefetchMgr()
    : m_Lock(nullptr), m_Type(RESULT_NONE), m_TotalPages(0), m_TotalItems(0), m_ItemsPerPage(0), m_Query{},
      m_Pages(8) {}

void DUDUVudAE::PrefetchMgr::SetMutex(IAEKernel::Mutex* lock) { m_Lock = lock; }

void DUDUVudAE::PrefetchMgr::Update(AEArray<AEString>& waiting, Result_Type type, unsigned totalPages,
                                    unsigned totalItems, unsigned itemsPerPage, int p1, int p2, int p3) {
  bool changed = type != m_Type || totalPages != m_TotalPages || totalItems != m_TotalItems ||
                 itemsPerPage != m_ItemsPerPage || p1 != m_Query[0] || p2 != m_Query[1] || p3 != m_Query[2];
  m_Type = type;
  m_TotalPages = totalPages;
  m_TotalItems = totalItems;
  m_ItemsPerPage = itemsPerPage;
  m_Query[0] = p1;
  m_Query[1] = p2;
  m_Query[2] = p3;
  if (!changed) return;
  // Pages and box art of another query are of no use for this one.
  Locked lock(m_Lock);
  m_Pages.Clear();
  waiting.Clear();
}

void DUDUVudAE::PrefetchMgr::MarkPagePrefetched(unsigned page) {
  Locked lock(m_Lock);
  m_Pages.Append(page);
}

bool DUDUVudAE::PrefetchMgr::IsPageAlreadyPrefetched(unsigned page) const {
  for (size_t k = 0; k < m_Pages.Size(); ++k) {
    if (m_Pages[k] == page) return true;
  }
  return false;
}

void DUDUVudAE::PrefetchMgr::GetPagesForPrefetch(unsigned current, unsigned wanted, unsigned* pages,
                                                 unsigned& found) {
  VLLogOutputwithConfig(Trace(),
                        "DUDUVudAE::PrefetchMgr::GetPagesForPrefetch enter,CurrentPageNumber:%d, pageNumsToRequest:%d,\n",
                        current, wanted);
  Locked lock(m_Lock);
  found = 0;
  const unsigned total = m_TotalPages;
  if (!pages || total == 0 || wanted == 0 || current == 0 || current > total) return;
  const unsigned n = wanted < total ? wanted : total;
  const unsigned backward = n / 2;
  const unsigned forward = n - backward;
  // Page numbers run from 1 to total and wrap around at both ends.
  auto wrap = [total](unsigned p) { return p % total == 0 ? total : p % total; };

  AEArray<unsigned> next;
  for (unsigned i = 1; i <= forward; ++i) {
    unsigned p = wrap(current + i);
    if (IsPageAlreadyPrefetched(p)) continue;
    VLLogOutputwithConfig(Trace(), "DUDUVudAE::PrefetchMgr::GetPagesForPrefetch, pageForNext[%d]:%d \n",
                          static_cast<int>(next.Size()), p);
    next.Append(p);
  }
  VLLogOutputwithConfig(Trace(), "DUDUVudAE::PrefetchMgr::GetPagesForPrefetch, pageNumsForNext:%d \n",
                        static_cast<int>(next.Size()));
  AEArray<unsigned> previous;
  for (unsigned i = 1; i <= backward; ++i) {
    unsigned p = wrap(current + total - i);
    if (IsPageAlreadyPrefetched(p)) continue;
    VLLogOutputwithConfig(Trace(), "DUDUVudAE::PrefetchMgr::GetPagesForPrefetch,,pageForPre[%d]:%d \n",
                          static_cast<int>(previous.Size()), p);
    previous.Append(p);
  }
  VLLogOutputwithConfig(Trace(), "DUDUVudAE::PrefetchMgr::GetPagesForPrefetch, pageNumsForNext:%d \n",
                        static_cast<int>(previous.Size()));
  // When every page is wanted the two directions meet: a page already going forward is not
  // fetched twice.
  for (size_t k = previous.Size(); k-- > 0;) {
    for (size_t f = 0; f < next.Size(); ++f) {
      if (next[f] == previous[k]) {
        previous.Remove(k);
        break;
      }
    }
  }
  size_t f = 0, b = 0;
  for (unsigned turn = 0; turn < n; ++turn) {
    AEArray<unsigned>& side = turn % 2 == 0 ? next : previous;
    size_t& taken = turn % 2 == 0 ? f : b;
    if (taken >= side.Size()) continue;
    pages[found] = side[taken++];
    VLLogOutputwithConfig(Trace(), "DUDUVudAE::PrefetchMgr::GetPagesForPrefetch,,pageNum[%d]:%d \n", found,
                          pages[found]);
    ++found;
  }
  VLLogOutputwithConfig(Trace(), "DUDUVudAE::PrefetchMgr::GetPagesForPrefetch left,pageNumsFound:%d \n", found);
}

// --- The records and workers of the prefetch threads ----------------------------------------------

// A page prefetch: the query of the page shown and the pages to fetch; or a box-art download.
struct DUDUVudAE::PrefetchParam : Param {
  using Param::Param;

  // Fetches each page through fetch(page, &response) into the cache, up to the first failure,
  // then queues the box art of the titles on them.
  template <class Response, class Fetch>
  void FetchPages(const char* name, Fetch fetch);
  void DownloadBoxArts();
  VL_WS_Handle* CataloguePrefetchClient() const;
  VL_WS_Handle* UserDataPrefetchClient() const;

  int current = 0;
  int itemsPerPage = 0;
  int query[3] = {};  // the query's own parameters, in the operation's order
  AEArray<unsigned> pages;
  int boxArtSize = 0;
  AEArray<AEString> prefixes;
};

template <class Response, class Fetch>
void DUDUVudAE::PrefetchParam::FetchPages(const char* name, Fetch fetch) {
  DUDUVudAE* instance = owner;
  AEArray<AEString> found;
  VLLogOutputwithConfig(Trace(), "%s, prefetchpages size:%d \n", name, static_cast<int>(pages.Size()));
  for (size_t k = 0; k < pages.Size(); ++k) {
    unsigned page = pages[k];
    if (page == 0 || page == static_cast<unsigned>(current)) break;
    VLLogOutputwithConfig(Trace(), "%s, page:%d begin  \n", name, page);
    Response response = {};
    VL_WS_Status status = fetch(static_cast<int>(page), &response);
    if (status != VL_WS_OK) {
      VL_WS_release(&response);
      VLLogOutputwithConfig(Trace(), "%s page:%d end (retcode:%d)\n", name, page, status);
      break;
    }
    instance->m_Prefetch.MarkPagePrefetched(page);
    for (int t = response.Titles.Count - 1; t >= 0; --t) {
      const char* prefix = response.Titles.Items[t].BoxArtPrefix;
      if (!prefix || !*prefix) continue;
      VLLogOutputwithConfig(Trace(), "%s, boxarts append\n", name);
      found.Append(AEString(prefix));
    }
    VL_WS_release(&response);
    VLLogOutputwithConfig(Trace(), "%s page:%d end (retcode:%d)\n", name, page, 0);
  }
  instance->AddWaitingForDownloadBoxArts(found);
  delete this;
  instance->m_PagePrefetchRunning.store(false);
}

void DUDUVudAE::PrefetchParam::DownloadBoxArts() {
  DUDUVudAE* instance = owner;
  for (size_t k = 0; k < prefixes.Size(); ++k) {
    const char* prefix = prefixes[k].CString();
    VLLogOutputwithConfig(Trace(), "DUDUVud::prefetch_getBoxArts (%s) begin \n", prefix);
    VL_WS_String location = {};
    VL_WS_Status status = VL_WS_getBoxArtImage(&instance->m_BoxArtPrefetchClient,
                                               static_cast<VL_WS_BoxArtSize>(boxArtSize), prefix, &location);
    VL_WS_release(&location);
    VLLogOutputwithConfig(Trace(), "DUDUVud::prefetch_getBoxArts (%s) end (retcode:%d)\n", prefix, status);
  }
  delete this;
  instance->m_BoxArtPrefetchRunning.store(false);
}

namespace DUDUVud {
namespace {

DUDUVudAE::PrefetchParam& Prefetch(void* p) {
  return *static_cast<DUDUVudAE::PrefetchParam*>(static_cast<DUDUVudAE::Param*>(p));
}

void prefetch_getTitles(void* p) {
  DUDUVudAE::PrefetchParam& r = Prefetch(p);
  VL_WS_Handle* client = r.CataloguePrefetchClient();
  r.FetchPages<VL_WS_TitlesResponse>("DUDUVud::prefetch_getTitles", [&r, client](int page, VL_WS_TitlesResponse* out) {
    return VL_WS_getTitles(client, r.query[0], page, r.itemsPerPage, r.query[1], out);
  });
}

void prefetch_getMyVideos(void* p) {
  DUDUVudAE::PrefetchParam& r = Prefetch(p);
  VL_WS_Handle* client = r.UserDataPrefetchClient();
  r.FetchPages<VL_WS_MyVideosResponse>("DUDUVud::prefetch_getMyVideos",
                                       [&r, client](int page, VL_WS_MyVideosResponse* out) {
                                         return VL_WS_getMyVideos(client, page, r.itemsPerPage, r.query[0],
                                                                  r.query[1], r.query[2], out);
                                       });
}

void prefetch_getWishlistItems(void* p) {
  DUDUVudAE::PrefetchParam& r = Prefetch(p);
  VL_WS_Handle* client = r.UserDataPrefetchClient();
  r.FetchPages<VL_WS_WishlistItemsResponse>(
      "DUDUVud::prefetch_getWishlistItems", [&r, client](int page, VL_WS_WishlistItemsResponse* out) {
        return VL_WS_getWishlistItems(client, static_cast<VL_WS_SortOrder>(r.query[0]), page, r.itemsPerPage,
                                      r.query[1], out);
      });
}

void prefetch_getBoxArts(void* p) { Prefetch(p).DownloadBoxArts(); }

}  // namespace
}  // namespace DUDUVud

// --- Scheduling -----------------------------------------------------------------------------------

VL_WS_Handle* DUDUVudAE::PrefetchParam::CataloguePrefetchClient() const { return &owner->m_CataloguePrefetchClient; }
VL_WS_Handle* DUDUVudAE::PrefetchParam::UserDataPrefetchClient() const { return &owner->m_UserDataPrefetchClient; }

void DUDUVudAE::MergeWaitingBoxArts(AEArray<AEString>& waiting, const AEArray<AEString>& prefixes) {
  AEArray<AEString> merged(prefixes);
  for (size_t k = 0; k < waiting.Size() && merged.Size() <= kMaxWaitingBoxArts; ++k) merged.Append(waiting[k]);
  waiting = std::move(merged);
}

void DUDUVudAE::AddWaitingForDownloadBoxArts(const AEArray<AEString>& prefixes) {
  if (prefixes.IsEmpty()) return;
  Locked lock(m_PrefetchLock);
  MergeWaitingBoxArts(m_WaitingBoxArts, prefixes);
}

void DUDUVudAE::RunPrefetchThread(const char* name, void (*worker)(void*), PrefetchParam* record) {
  bool pages = strcmp(name, "prefetch_getTitles") == 0;
  VLThread*& slot = pages ? m_PagePrefetchThread : m_BoxArtPrefetchThread;
  std::atomic<bool>& running = pages ? m_PagePrefetchRunning : m_BoxArtPrefetchRunning;
  // Raised before the thread exists, so that the engine's thread never sees a thread that has not
  // begun as a finished one.
  running.store(true);
  m_Lock->Lock();
  slot = VLThread::CreateThread();
  VL_ASSERT(slot != 0);
  if (!slot->Run(name, worker, record)) {
    VLLogOutputwithConfig({s_Log.Id(), 1}, "Failed to launch worker thread: %s!\n", name);
    VLThread::DestroyThread(slot);
    slot = nullptr;
    delete record;
    running.store(false);
  }
  m_Lock->Unlock();
}

void DUDUVudAE::SchedulePrefetch() {
  if (m_PagePrefetchRunning.load()) return;
  m_PrefetchWanted = false;
  PrefetchParam* record = nullptr;
  void (*worker)(void*) = nullptr;
  // A page result with more pages: remember the query, count the page shown, and make a record of
  // the neighbours still to fetch.
  auto pagesAround = [this, &record](Result_Type type, int current, int perPage, int total, int items, int p1,
                                     int p2, int p3) {
    if (total < 2) return;
    m_Prefetch.Update(m_WaitingBoxArts, type, total, items, perPage, p1, p2, p3);
    m_Prefetch.MarkPagePrefetched(current);
    unsigned pages[kPagesWanted];
    unsigned found = 0;
    m_Prefetch.GetPagesForPrefetch(current, kPagesWanted, pages, found);
    if (found == 0) return;
    record = new PrefetchParam(this);
    record->current = current;
    record->itemsPerPage = perPage;
    record->query[0] = p1;
    record->query[1] = p2;
    record->query[2] = p3;
    record->pages.Append(pages, found);
  };
  const Result::Data& d = m_Result.data;
  if (m_CacheData & VL_WS_CacheParam::CACHE_METADATA) {
    if (m_Result.type == RESULT_TITLES) {
      pagesAround(RESULT_TITLES, d.Titles.CurrentPageNumber, d.Titles.ItemsPerPage, d.Titles.TotalPages,
                  d.Titles.TotalItems, d.Titles.GenreID, m_PurchaseType, 0);
      worker = DUDUVud::prefetch_getTitles;
    } else if (m_Result.type == RESULT_ALL_TV_EPISODE_LISTINGS && d.AllEpisodes.Count >= 2) {
      // The episodes after the first one shown: their box art replaces what was waiting.
      AEArray<AEString> prefixes;
      for (int k = 1; k < d.AllEpisodes.Count; ++k) {
        const char* prefix = d.AllEpisodes.Items[k].BoxArtPrefix;
        if (prefix && *prefix) prefixes.Append(AEString(prefix));
      }
      Locked lock(m_PrefetchLock);
      m_WaitingBoxArts = std::move(prefixes);
    }
  }
  if (m_CacheData & VL_WS_CacheParam::CACHE_USERDATA) {
    if (m_Result.type == RESULT_MY_VIDEOS) {
      pagesAround(RESULT_MY_VIDEOS, d.MyVideos.CurrentPageNumber, d.MyVideos.ItemsPerPage,
                  d.MyVideos.TotalPages, d.MyVideos.TotalItems, m_PurchaseType, m_TypeFilter, m_WatchStatus);
      worker = DUDUVud::prefetch_getMyVideos;
    } else if (m_Result.type == RESULT_WISHLIST_ITEMS) {
      pagesAround(RESULT_WISHLIST_ITEMS, d.Wishlist.CurrentPageNumber, d.Wishlist.ItemsPerPage,
                  d.Wishlist.TotalPages, d.Wishlist.TotalItems, m_SortOrder, m_TypeFilter, 0);
      worker = DUDUVud::prefetch_getWishlistItems;
    }
  }
  if (!record) return;
  SafeDestroyThread(m_PagePrefetchThread);
  RunPrefetchThread("prefetch_getTitles", worker, record);
}

void DUDUVudAE::StartBoxArtDownload() {
  if (!m_IdleSeen || m_PagePrefetchRunning.load() || m_BoxArtPrefetchRunning.load()) return;
  // Without its own client (CacheData without catalogue pages) nothing could be downloaded.
  if (m_CacheType != kFileCache || !(m_CacheData & VL_WS_CacheParam::CACHE_BOXART) || !m_BoxArtPrefetchClient.client) {
    return;
  }
  PrefetchParam* record = nullptr;
  {
    Locked lock(m_PrefetchLock);
    if (m_WaitingBoxArts.IsEmpty()) return;
    record = new PrefetchParam(this);
    record->boxArtSize = m_BoxArtSize;
    record->prefixes.Append(m_WaitingBoxArts[0]);
    m_WaitingBoxArts.Remove(0);
  }
  SafeDestroyThread(m_BoxArtPrefetchThread);
  RunPrefetchThread("prefetch_getBoxArts", DUDUVud::prefetch_getBoxArts, record);
}
