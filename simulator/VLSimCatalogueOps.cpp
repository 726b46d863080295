// VLSimCatalogueOps: the catalogue operations of the browse service, and the same operations
// where the streaming service offers them too (same request and result elements).
#include "VLSimSoap.h"
#include "soapRealTimeBrowseSoap12Service.h"
#include "soapStreamAPISoap12Service.h"

namespace {

int NotServed(struct soap* soap) {
  return soap_receiver_fault(soap, "The store simulator does not serve this operation", nullptr);
}

VL1__GenreRequest* Navigation(struct soap* soap) {
  const std::vector<VLSimGenre>& genres = VLSimCatalogueOf(soap).Genres();
  VL1__GenreRequest* result = soap_new_VL1__GenreRequest(soap);
  result->Genres = soap_new_VL1__ArrayOfGenre(soap);
  result->Genres->__sizeGenre = static_cast<int>(genres.size());
  result->Genres->Genre = static_cast<VL1__Genre**>(soap_malloc(soap, (genres.size() + 1) * sizeof(VL1__Genre*)));
  for (size_t i = 0; i < genres.size(); ++i) {
    VL1__Genre* genre = soap_new_VL1__Genre(soap);
    genre->ID = genres[i].id;
    genre->Name = VLSimText(soap, genres[i].name);
    genre->Visible = genres[i].visible ? true_ : false_;
    genre->ParentId = genres[i].parent;
    result->Genres->Genre[i] = genre;
  }
  return result;
}

VL1__GetTitlesResponse* Search(struct soap* soap, const char* query, int page, int itemsPerPage, int purchaseType,
                               int titleType, bool detail) {
  if (!query || !*query) {
    VL1__GetTitlesResponse* response = soap_new_VL1__GetTitlesResponse(soap);
    return VLSimReply(soap, response, VLSimCode::kBadRequest, "A query is needed");
  }
  std::vector<const VLSimTitle*> found;
  for (const VLSimTitle* title : VLSimCatalogueOf(soap).Search(query, detail))
    if (titleType == 0 || (titleType == 1) == title->tv) found.push_back(title);
  return VLSimTitlesPage(soap, found, 0, page, itemsPerPage, purchaseType);
}

int GetGenreLabel(struct soap* soap, _VL1__getGenreLabel* request, _VL1__getGenreLabelResponse& response) {
  VL1__GetGenreLabelResponse* result = soap_new_VL1__GetGenreLabelResponse(soap);
  response.getGenreLabelResult = result;
  const VLSimGenre* genre = VLSimCatalogueOf(soap).FindGenre(request->GenreID);
  if (!genre) {
    VLSimReply(soap, result, VLSimCode::kUnknownItem, "Unknown genre");
    return SOAP_OK;
  }
  result->Label = VLSimText(soap, genre->name);
  result->LabelMessage = VLSimText(soap, genre->labelMessage);
  VLSimReply(soap, result, 0);
  return SOAP_OK;
}

VL1__GetTitlesResponse* GenrePage(struct soap* soap, int genre, int page, int itemsPerPage, int purchaseType) {
  const VLSimCatalogue& catalogue = VLSimCatalogueOf(soap);
  if (!catalogue.FindGenre(genre)) {
    VL1__GetTitlesResponse* response = soap_new_VL1__GetTitlesResponse(soap);
    response->GenreID = genre;
    return VLSimReply(soap, response, VLSimCode::kUnknownItem, "Unknown genre");
  }
  return VLSimTitlesPage(soap, catalogue.TitlesInGenre(genre), genre, page, itemsPerPage, purchaseType);
}

int GetTitlesByGenreArray(struct soap* soap, _VL1__getTitlesByGenreArray* request,
                          _VL1__getTitlesByGenreArrayResponse& response) {
  VL1__ArrayOfGetTitlesResponse* result = soap_new_VL1__ArrayOfGetTitlesResponse(soap);
  int count = request->GenreIDs ? request->GenreIDs->__sizeint : 0;
  result->__sizeGetTitlesResponse = count;
  result->GetTitlesResponse =
      static_cast<VL1__GetTitlesResponse**>(soap_malloc(soap, (count + 1) * sizeof(VL1__GetTitlesResponse*)));
  for (int i = 0; i < count; ++i)
    result->GetTitlesResponse[i] = GenrePage(soap, request->GenreIDs->int_[i], request->CurrentPageNumber,
                                             request->ItemsPerPage, request->PurchaseType);
  response.getTitlesByGenreArrayResult = result;
  return SOAP_OK;
}

int GetTitleListing(struct soap* soap, _VL1__getTitleListing* request, _VL1__getTitleListingResponse& response) {
  const VLSimTitle* title = VLSimCatalogueOf(soap).FindTitle(request->TitleID);
  if (title) {
    response.getTitleListingResult = VLSimTitleListingResponse(soap, *title, nullptr, VLSimAccountOf(soap));
    return SOAP_OK;
  }
  response.getTitleListingResult = soap_new_VL1__TitleListingResponse(soap);
  response.getTitleListingResult->TitleID = request->TitleID;
  VLSimReply(soap, response.getTitleListingResult, VLSimCode::kUnknownItem, "Unknown title");
  return SOAP_OK;
}

int GetTvEpisodeListByTitleID(struct soap* soap, _VL1__getTvEpisodeListByTitleID* request,
                              _VL1__getTvEpisodeListByTitleIDResponse& answer) {
  const VLSimCatalogue& catalogue = VLSimCatalogueOf(soap);
  VL1__TvEpisodeList* response = soap_new_VL1__TvEpisodeList(soap);
  answer.getTvEpisodeListByTitleIDResult = response;
  const VLSimTitle* title = catalogue.FindTitle(request->TitleID);
  if (!title || !title->tv) {
    VLSimReply(soap, response, VLSimCode::kUnknownItem, "Unknown television series");
    return SOAP_OK;
  }
  response->Episodes = soap_new_VL1__ArrayOfTvEpisode(soap);
  response->Episodes->__sizeTvEpisode = static_cast<int>(title->episodes.size());
  response->Episodes->TvEpisode =
      static_cast<VL1__TvEpisode**>(soap_malloc(soap, (title->episodes.size() + 1) * sizeof(VL1__TvEpisode*)));
  for (size_t i = 0; i < title->episodes.size(); ++i) {
    const VLSimEpisode* episode = catalogue.FindEpisode(title->episodes[i]);
    VL1__TvEpisode* item = soap_new_VL1__TvEpisode(soap);
    item->EpisodeID = episode->id;
    item->EpisodeName = VLSimText(soap, episode->name);
    item->EpisodeNumber = episode->number;
    response->Episodes->TvEpisode[i] = item;
  }
  VLSimReply(soap, response, 0);
  return SOAP_OK;
}

int GetTvEpisodeListing(struct soap* soap, _VL1__getTvEpisodeListing* request,
                        _VL1__getTvEpisodeListingResponse& response) {
  const VLSimCatalogue& catalogue = VLSimCatalogueOf(soap);
  const VLSimEpisode* episode = catalogue.FindEpisode(request->EpisodeID);
  if (episode) {
    response.getTvEpisodeListingResult =
        VLSimTitleListingResponse(soap, *catalogue.FindTitle(episode->title), episode, VLSimAccountOf(soap));
    return SOAP_OK;
  }
  response.getTvEpisodeListingResult = soap_new_VL1__TitleListingResponse(soap);
  VLSimReply(soap, response.getTvEpisodeListingResult, VLSimCode::kUnknownItem, "Unknown episode");
  return SOAP_OK;
}

int GetAllTvEpisodeListings(struct soap* soap, _VL1__getAllTvEpisodeListings* request,
                            _VL1__getAllTvEpisodeListingsResponse& response) {
  const VLSimCatalogue& catalogue = VLSimCatalogueOf(soap);
  VL1__ArrayOfTitleListingResponse* result = soap_new_VL1__ArrayOfTitleListingResponse(soap);
  response.getAllTvEpisodeListingsResult = result;
  const VLSimTitle* title = catalogue.FindTitle(request->TitleID);
  size_t count = title ? title->episodes.size() : 0;
  int account = VLSimAccountOf(soap);
  result->__sizeTitleListingResponse = static_cast<int>(count);
  result->TitleListingResponse =
      static_cast<VL1__TitleListingResponse**>(soap_malloc(soap, (count + 1) * sizeof(VL1__TitleListingResponse*)));
  for (size_t i = 0; i < count; ++i)
    result->TitleListingResponse[i] =
        VLSimTitleListingResponse(soap, *title, catalogue.FindEpisode(title->episodes[i]), account);
  return SOAP_OK;
}

int ShouldUpdateCache(struct soap* soap, _VL1__shouldUpdateCache* request, _VL1__shouldUpdateCacheResponse& response) {
  response.shouldUpdateCacheResult =
      !request->UTCTime || VLSimStoreOf(soap).LastCacheLoadTime() != request->UTCTime ? 1 : 0;
  return SOAP_OK;
}

int GetLastCacheLoadTimeUTC(struct soap* soap, _VL1__getLastCacheLoadTimeUTC*,
                            _VL1__getLastCacheLoadTimeUTCResponse& response) {
  response.getLastCacheLoadTimeUTCResult = VLSimText(soap, VLSimStoreOf(soap).LastCacheLoadTime());
  return SOAP_OK;
}

int SearchForTitle(struct soap* soap, _VL1__searchForTitle* request, _VL1__searchForTitleResponse& response) {
  response.searchForTitleResult = Search(soap, request->Query, request->CurrentPageNumber, request->ItemsPerPage,
                                         request->PurchaseType, request->TitleType, false);
  return SOAP_OK;
}

}  // namespace

// ---- Operations of both the browse and the streaming service ----

VL_SIM_SHARED_OPERATION(RealTimeBrowseSoap12Service, StreamAPISoap12Service, searchForTitle, SearchForTitle)
VL_SIM_SHARED_OPERATION(RealTimeBrowseSoap12Service, StreamAPISoap12Service, getGenreLabel, GetGenreLabel)
VL_SIM_SHARED_OPERATION(RealTimeBrowseSoap12Service, StreamAPISoap12Service, getTitlesByGenreArray, GetTitlesByGenreArray)
VL_SIM_SHARED_OPERATION(RealTimeBrowseSoap12Service, StreamAPISoap12Service, getTitleListing, GetTitleListing)
VL_SIM_SHARED_OPERATION(RealTimeBrowseSoap12Service, StreamAPISoap12Service, getTvEpisodeListByTitleID, GetTvEpisodeListByTitleID)
VL_SIM_SHARED_OPERATION(RealTimeBrowseSoap12Service, StreamAPISoap12Service, getTvEpisodeListing, GetTvEpisodeListing)
VL_SIM_SHARED_OPERATION(RealTimeBrowseSoap12Service, StreamAPISoap12Service, getAllTvEpisodeListings, GetAllTvEpisodeListings)
VL_SIM_SHARED_OPERATION(RealTimeBrowseSoap12Service, StreamAPISoap12Service, shouldUpdateCache, ShouldUpdateCache)
VL_SIM_SHARED_OPERATION(RealTimeBrowseSoap12Service, StreamAPISoap12Service, getLastCacheLoadTimeUTC, GetLastCacheLoadTimeUTC)

// ---- RealTimeBrowse only ----

int RealTimeBrowseSoap12Service::getFileType(_VL1__getFileType*, _VL1__getFileTypeResponse& response) {
  VL1__FileType* type = soap_new_VL1__FileType(soap);
  type->File_USCOREDRMProvider = VL1__DRMProvider__PLAY_USCOREREADY;
  type->File_USCOREAccessType = static_cast<VL1__AccessType>(VLSimStoreOf(soap).AccessType());
  type->File_USCOREFileProfile = VL1__FileProfile__HIGH_USCOREDEFINITION;
  type->File_USCOREVideoFormat = VL1__VideoFormat__H264;
  type->File_USCOREFileExtension = VL1__FileExtension__MP4;
  response.getFileTypeResult = type;
  return SOAP_OK;
}

int RealTimeBrowseSoap12Service::getNavigation(_VL1__getNavigation*, _VL1__getNavigationResponse& response) {
  response.getNavigationResult = Navigation(soap);
  return SOAP_OK;
}

int RealTimeBrowseSoap12Service::searchForTitleDetail(_VL1__searchForTitleDetail* request,
                                                      _VL1__searchForTitleDetailResponse& response) {
  response.searchForTitleDetailResult = Search(soap, request->Query, request->CurrentPageNumber,
                                               request->ItemsPerPage, request->PurchaseType, request->TitleType, true);
  return SOAP_OK;
}

int RealTimeBrowseSoap12Service::getTitlesByNavigation(_VL1__getTitlesByNavigation* request,
                                                       _VL1__getTitlesByNavigationResponse& response) {
  response.getTitlesByNavigationResult = GenrePage(soap, request->GenreID, request->CurrentPageNumber,
                                                   request->ItemsPerPage, request->PurchaseType);
  return SOAP_OK;
}

int RealTimeBrowseSoap12Service::getTitleListingByAsset(_VL1__getTitleListingByAsset*,
                                                        _VL1__getTitleListingByAssetResponse&) {
  return NotServed(soap);
}

int RealTimeBrowseSoap12Service::translateTivoExternalId(_VL1__translateTivoExternalId* request,
                                                         _VL1__translateTivoExternalIdResponse& response) {
  VL1__TranslatedTivoExternalIdResponse* result = soap_new_VL1__TranslatedTivoExternalIdResponse(soap);
  result->TivoExternalId = request->TivoExternalId;
  const VLSimTitle* title = request->TivoExternalId ? VLSimCatalogueOf(soap).FindTivo(request->TivoExternalId) : nullptr;
  if (title) result->TitleId = title->id;
  response.translateTivoExternalIdResult =
      VLSimReply(soap, result, title ? 0 : VLSimCode::kUnknownItem, title ? "" : "Unknown TiVo external ID");
  return SOAP_OK;
}

int RealTimeBrowseSoap12Service::translateSkuId(_VL1__translateSkuId* request, _VL1__translateSkuIdResponse& response) {
  VL1__TranslateSkuIdResponse* result = soap_new_VL1__TranslateSkuIdResponse(soap);
  const VLSimProduct* product = VLSimCatalogueOf(soap).FindProduct(request->SkuId);
  if (product) result->TitleId = product->title;
  response.translateSkuIdResult =
      VLSimReply(soap, result, product ? 0 : VLSimCode::kUnknownItem, product ? "" : "Unknown SKU");
  return SOAP_OK;
}

int RealTimeBrowseSoap12Service::getRecommendedTitles(_VL1__getRecommendedTitles* request,
                                                      _VL1__getRecommendedTitlesResponse& response) {
  const VLSimCatalogue& catalogue = VLSimCatalogueOf(soap);
  VL1__RecommendedTitlesResponse* result = soap_new_VL1__RecommendedTitlesResponse(soap);
  response.getRecommendedTitlesResult = result;
  if (!catalogue.FindTitle(request->TitleId)) {
    VLSimReply(soap, result, VLSimCode::kUnknownItem, "Unknown title");
    return SOAP_OK;
  }
  std::vector<const VLSimTitle*> titles = catalogue.Recommendations(request->TitleId);
  result->Titles = soap_new_VL1__ArrayOfTitleListing(soap);
  result->Titles->__sizeTitleListing = static_cast<int>(titles.size());
  result->Titles->TitleListing =
      static_cast<VL1__TitleListing**>(soap_malloc(soap, (titles.size() + 1) * sizeof(VL1__TitleListing*)));
  for (size_t i = 0; i < titles.size(); ++i) {
    result->Titles->TitleListing[i] = soap_new_VL1__TitleListing(soap);
    VLSimFillTitle(soap, *titles[i], nullptr, 2, result->Titles->TitleListing[i]);
    result->Titles->TitleListing[i]->TitlePosition = static_cast<short>(i + 1);
  }
  VLSimReply(soap, result, 0);
  return SOAP_OK;
}

int RealTimeBrowseSoap12Service::getRecommendedTitles_USCORESpecifyOutput(
    _VL1__getRecommendedTitles_USCORESpecifyOutput*, _VL1__getRecommendedTitles_USCORESpecifyOutputResponse&) {
  return NotServed(soap);
}

// ---- StreamAPI's own names for browse operations ----

int StreamAPISoap12Service::getStreamingNavigation(_VL1__getStreamingNavigation*,
                                                   _VL1__getStreamingNavigationResponse& response) {
  response.getStreamingNavigationResult = Navigation(soap);
  return SOAP_OK;
}

int StreamAPISoap12Service::getTitlesByGenreCSV(_VL1__getTitlesByGenreCSV*, _VL1__getTitlesByGenreCSVResponse&) {
  return NotServed(soap);
}

int StreamAPISoap12Service::getTitlesByStreamingNavigation(_VL1__getTitlesByStreamingNavigation* request,
                                                           _VL1__getTitlesByStreamingNavigationResponse& response) {
  response.getTitlesByStreamingNavigationResult = GenrePage(soap, request->GenreID, request->CurrentPageNumber,
                                                            request->ItemsPerPage, request->PurchaseType);
  return SOAP_OK;
}

