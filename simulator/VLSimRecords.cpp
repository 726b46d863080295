// VLSimRecords: the catalogue's records as the services answer them (titles, products, pages).
#include <algorithm>

#include "VLSimSoap.h"
#include "VLStoreHosts.h"

namespace {

xsd__boolean Bool(bool value) { return value ? true_ : false_; }

template <typename Item>
Item** NewPointers(struct soap* soap, size_t count) {
  return static_cast<Item**>(soap_malloc(soap, std::max<size_t>(count, 1) * sizeof(Item*)));
}

VL1__ProductListing* Product(struct soap* soap, const VLSimProduct& product) {
  VL1__ProductListing* listing = soap_new_VL1__ProductListing(soap);
  listing->SkuID = product.sku;
  listing->PurchaseType = static_cast<VL1__StreamAPIPurchaseType>(product.purchaseType);
  listing->Price = VLSimText(soap, product.price);
  listing->ExpireDate = VLSimText(soap, product.expireDate);
  listing->RentalPeriod = product.rentalHours;
  listing->AvailableAssets = soap_new_VL1__ArrayOfFileProfile(soap);
  listing->AvailableAssets->__sizeFileProfile = static_cast<int>(product.profiles.size());
  listing->AvailableAssets->FileProfile = static_cast<VL1__FileProfile*>(
      soap_malloc(soap, std::max<size_t>(product.profiles.size(), 1) * sizeof(VL1__FileProfile)));
  for (size_t i = 0; i < product.profiles.size(); ++i)
    listing->AvailableAssets->FileProfile[i] = static_cast<VL1__FileProfile>(product.profiles[i]);
  listing->AvailableAudioProfiles = soap_new_VL1__ArrayOfAudioFile(soap);
  listing->AvailableAudioProfiles->__sizeAudioFile = static_cast<int>(product.audio.size());
  listing->AvailableAudioProfiles->AudioFile = NewPointers<VL1__AudioFile>(soap, product.audio.size());
  for (size_t i = 0; i < product.audio.size(); ++i) {
    VL1__AudioFile* audio = soap_new_VL1__AudioFile(soap);
    audio->AssetAudioID = product.sku * 10 + static_cast<int>(i);
    audio->FileLocation = VLSimText(soap, "https://" VL_STORE_PRODUCTION_HOST "/media/audio/" +
                                              std::to_string(audio->AssetAudioID) + ".mp4");
    audio->ContainsVideo = Bool(i == 0);
    audio->AudioAssetProfile = static_cast<VL1__AudioProfile>(product.audio[i]);
    listing->AvailableAudioProfiles->AudioFile[i] = audio;
  }
  return listing;
}

bool Sells(const VLSimCatalogue& catalogue, const VLSimTitle& title, int purchaseType) {
  if (purchaseType != 0 && purchaseType != 1) return true;
  for (int sku : title.products)
    if (catalogue.FindProduct(sku)->purchaseType == purchaseType) return true;
  for (int episode : title.episodes)
    for (int sku : catalogue.FindEpisode(episode)->products)
      if (catalogue.FindProduct(sku)->purchaseType == purchaseType) return true;
  return false;
}

}  // namespace

void VLSimFillTitle(struct soap* soap, const VLSimTitle& title, const VLSimEpisode* episode, int purchaseType,
                    VL1__TitleListing* listing) {
  const VLSimCatalogue& catalogue = VLSimCatalogueOf(soap);
  listing->TitleID = title.id;
  listing->TitleName = VLSimText(soap, title.name);
  listing->BoxArtPrefix = VLSimText(soap, title.boxArt);
  listing->EpisodeNumber = episode ? episode->number : 0;
  listing->IsTvListing = Bool(title.tv);
  listing->MPAARating = VLSimText(soap, title.mpaa);
  listing->CHVRSRating = VLSimText(soap, title.chvrs);
  listing->IsTHXMediaDirectorEnabled = Bool(title.thx);
  listing->IsTHXMediaDirectorEnabledForTrailer = Bool(title.thxTrailer);
  listing->LoyaltyPointsForBuy = VLSimText(soap, title.loyaltyBuy);
  listing->LoyaltyPointsForRent = VLSimText(soap, title.loyaltyRent);

  listing->BonusAssets = soap_new_VL1__ArrayOfBonusAsset(soap);
  listing->BonusAssets->__sizeBonusAsset = static_cast<int>(title.bonus.size());
  listing->BonusAssets->BonusAsset = NewPointers<VL1__BonusAsset>(soap, title.bonus.size());
  for (size_t i = 0; i < title.bonus.size(); ++i) {
    const VLSimBonus* bonus = catalogue.FindBonus(title.bonus[i]);
    VL1__BonusAsset* asset = soap_new_VL1__BonusAsset(soap);
    asset->BonusAssetID = bonus->id;
    asset->Profile = static_cast<VL1__FileProfile>(bonus->profile);
    asset->BonusType = static_cast<VL1__BonusAssetType>(bonus->type);
    listing->BonusAssets->BonusAsset[i] = asset;
  }

  std::vector<const VLSimProduct*> products;
  for (int sku : episode ? episode->products : title.products) products.push_back(catalogue.FindProduct(sku));
  if (purchaseType == 0 || purchaseType == 1)
    products.erase(std::remove_if(products.begin(), products.end(),
                                  [purchaseType](const VLSimProduct* p) { return p->purchaseType != purchaseType; }),
                   products.end());
  listing->AvailableProducts = soap_new_VL1__ArrayOfProductListing(soap);
  listing->AvailableProducts->__sizeProductListing = static_cast<int>(products.size());
  listing->AvailableProducts->ProductListing = NewPointers<VL1__ProductListing>(soap, products.size());
  for (size_t i = 0; i < products.size(); ++i) listing->AvailableProducts->ProductListing[i] = Product(soap, *products[i]);
}

VL1__TitleListingResponse* VLSimTitleListingResponse(struct soap* soap, const VLSimTitle& title,
                                                     const VLSimEpisode* episode, int account) {
  VL1__TitleListingResponse* response = soap_new_VL1__TitleListingResponse(soap);
  VLSimFillTitle(soap, title, episode, 2, response);
  if (episode) response->TitleName = VLSimText(soap, title.name + ": " + episode->name);
  response->Synopsys = VLSimText(soap, title.synopsis);
  response->UserRating = title.userRating;
  response->Directors = VLSimText(soap, title.directors);
  response->Actors = VLSimText(soap, title.actors);
  response->Writers = VLSimText(soap, title.writers);
  response->Producers = VLSimText(soap, title.producers);
  response->Copyright = VLSimText(soap, title.copyright);
  response->RunTime = VLSimText(soap, title.runtime);
  response->RatingReason = VLSimText(soap, title.ratingReason);
  response->IsAvailInUserWishList = Bool(account && VLSimStoreOf(soap).InWishlist(account, title.id));
  return VLSimReply(soap, response, 0);
}

VLSimPage VLSimPaging(int totalItems, int page, int itemsPerPage) {
  VLSimPage result;
  if (itemsPerPage < 1) return result;
  if (page < 1) page = 1;
  result.totalPages = (totalItems + itemsPerPage - 1) / itemsPerPage;
  long first = static_cast<long>(page - 1) * itemsPerPage;
  result.first = static_cast<int>(std::min<long>(first, totalItems));
  result.count = std::max(0, std::min(itemsPerPage, totalItems - result.first));
  return result;
}

VL1__GetTitlesResponse* VLSimTitlesPage(struct soap* soap, const std::vector<const VLSimTitle*>& all, int genre,
                                        int page, int itemsPerPage, int purchaseType) {
  const VLSimCatalogue& catalogue = VLSimCatalogueOf(soap);
  VL1__GetTitlesResponse* response = soap_new_VL1__GetTitlesResponse(soap);
  response->GenreID = genre;
  response->CurrentPageNumber = static_cast<short>(std::max(page, 1));
  response->ItemsPerPage = static_cast<short>(itemsPerPage);
  if (itemsPerPage < 1) return VLSimReply(soap, response, VLSimCode::kBadRequest, "ItemsPerPage must be at least 1");
  std::vector<const VLSimTitle*> titles;
  for (const VLSimTitle* title : all)
    if (Sells(catalogue, *title, purchaseType)) titles.push_back(title);
  VLSimPage paging = VLSimPaging(static_cast<int>(titles.size()), page, itemsPerPage);
  response->TotalItems = static_cast<short>(titles.size());
  response->TotalPages = static_cast<short>(paging.totalPages);
  response->Titles = soap_new_VL1__ArrayOfTitleListing(soap);
  response->Titles->__sizeTitleListing = paging.count;
  response->Titles->TitleListing = NewPointers<VL1__TitleListing>(soap, paging.count);
  for (int i = 0; i < paging.count; ++i) {
    VL1__TitleListing* listing = soap_new_VL1__TitleListing(soap);
    VLSimFillTitle(soap, *titles[paging.first + i], nullptr, purchaseType, listing);
    listing->TitlePosition = static_cast<short>(paging.first + i + 1);
    response->Titles->TitleListing[i] = listing;
  }
  return VLSimReply(soap, response, 0);
}
