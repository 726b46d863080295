#include "VLSimCatalogue.h"

#include <strings.h>

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <functional>
#include <set>
#include <sstream>

#include "soapH.h"

namespace {

// One tab-separated file: comment lines start with "#", the first other line names the columns.
class Table {
 public:
  bool Read(const std::string& folder, const char* name, std::string* error) {
    m_Name = name;
    std::ifstream in(folder + "/" + name);
    if (!in) return Fail(0, "cannot read the file", error);
    std::string line;
    for (int number = 1; std::getline(in, line); ++number) {
      if (!line.empty() && line.back() == '\r') line.pop_back();
      if (line.empty() || line[0] == '#') continue;
      std::vector<std::string> fields = Split(line, '\t');
      if (m_Columns.empty()) {
        m_Columns = fields;
        continue;
      }
      if (fields.size() != m_Columns.size())
        return Fail(number, "expected " + std::to_string(m_Columns.size()) + " fields, found " +
                                std::to_string(fields.size()), error);
      m_Rows.push_back(fields);
      m_Lines.push_back(number);
    }
    return true;
  }

  size_t Size() const { return m_Rows.size(); }
  int Line(size_t row) const { return m_Lines[row]; }
  // The field of the named column; a missing column is a programming error caught in tests.
  const std::string& Get(size_t row, const char* column) const {
    static const std::string kNone;
    for (size_t i = 0; i < m_Columns.size(); ++i)
      if (m_Columns[i] == column) return m_Rows[row][i];
    return kNone;
  }
  bool HasColumns(std::initializer_list<const char*> columns, std::string* error) const {
    for (const char* column : columns)
      if (std::find(m_Columns.begin(), m_Columns.end(), column) == m_Columns.end())
        return Fail(0, std::string("missing column \"") + column + "\"", error);
    return true;
  }
  bool Int(size_t row, const char* column, int* value, std::string* error) const {
    const std::string& text = Get(row, column);
    char* end = nullptr;
    long number = strtol(text.c_str(), &end, 10);
    if (text.empty() || *end != '\0' || number < -2147483647L || number > 2147483647L)
      return Fail(m_Lines[row], std::string(column) + " \"" + text + "\" is not a number", error);
    *value = static_cast<int>(number);
    return true;
  }
  bool Bool(size_t row, const char* column, bool* value, std::string* error) const {
    const std::string& text = Get(row, column);
    if (text == "1" || text == "true") *value = true;
    else if (text == "0" || text == "false") *value = false;
    else return Fail(m_Lines[row], std::string(column) + " \"" + text + "\" is not 0/1 or true/false", error);
    return true;
  }
  bool Fail(int line, const std::string& problem, std::string* error) const {
    *error = m_Name + (line ? ":" + std::to_string(line) : std::string()) + ": " + problem;
    return false;
  }

  static std::vector<std::string> Split(const std::string& text, char separator) {
    std::vector<std::string> parts;
    std::string part;
    std::istringstream in(text);
    while (std::getline(in, part, separator)) parts.push_back(part);
    if (!text.empty() && text.back() == separator) parts.push_back(std::string());
    return parts;
  }

 private:
  std::string m_Name;
  std::vector<std::string> m_Columns;
  std::vector<std::vector<std::string>> m_Rows;
  std::vector<int> m_Lines;
};

// Converts an enumeration name with the generated converter of the schema (one table of names).
template <typename Enum>
bool ParseEnum(int (*convert)(struct soap*, const char*, Enum*), const std::string& text, int* code) {
  struct soap* soap = soap_new();
  Enum value = static_cast<Enum>(0);
  bool ok = !text.empty() && convert(soap, text.c_str(), &value) == SOAP_OK;
  soap_free(soap);
  *code = static_cast<int>(value);
  return ok;
}

template <typename Enum>
bool ParseEnumList(const Table& table, size_t row, const char* column,
                   int (*convert)(struct soap*, const char*, Enum*), std::vector<int>* codes, std::string* error) {
  for (const std::string& name : Table::Split(table.Get(row, column), ',')) {
    int code = 0;
    if (!ParseEnum(convert, name, &code))
      return table.Fail(table.Line(row), std::string(column) + ": unknown value \"" + name + "\"", error);
    codes->push_back(code);
  }
  return true;
}

bool ParseCents(const std::string& price, int* cents) {
  size_t dot = price.find('.');
  if (price.empty() || dot == 0 || price.find_first_not_of("0123456789.") != std::string::npos ||
      (dot != std::string::npos && price.size() - dot != 3))
    return false;
  std::string digits = price;
  if (dot == std::string::npos) digits += "00";
  else digits.erase(dot, 1);
  *cents = atoi(digits.c_str());
  return true;
}

bool ContainsNoCase(const std::string& text, const std::string& part) {
  auto it = std::search(text.begin(), text.end(), part.begin(), part.end(),
                        [](char a, char b) { return tolower(static_cast<unsigned char>(a)) == tolower(static_cast<unsigned char>(b)); });
  return it != text.end();
}

}  // namespace

bool VLSimCatalogue::Load(const std::string& folder, std::string* error) {
  *this = VLSimCatalogue();
  Table genres, titles, products, episodes, bonus, accounts, gifts, config;
  if (!genres.Read(folder, "genres.tsv", error) || !titles.Read(folder, "titles.tsv", error) ||
      !products.Read(folder, "products.tsv", error) || !episodes.Read(folder, "episodes.tsv", error) ||
      !bonus.Read(folder, "bonus.tsv", error) || !accounts.Read(folder, "accounts.tsv", error) ||
      !gifts.Read(folder, "giftcertificates.tsv", error) || !config.Read(folder, "config.tsv", error))
    return false;
  if (!genres.HasColumns({"id", "parent", "visible", "name", "label_message"}, error) ||
      !titles.HasColumns({"id", "kind", "name", "boxart", "genres", "mpaa", "chvrs", "rating_reason",
                          "user_rating", "runtime", "directors", "actors", "writers", "producers",
                          "copyright", "tivo_id", "thx", "thx_trailer", "loyalty_buy", "loyalty_rent",
                          "synopsis"}, error) ||
      !products.HasColumns({"sku", "title", "episode", "type", "price", "rental_hours", "expire_date",
                            "profiles", "audio"}, error) ||
      !episodes.HasColumns({"id", "title", "number", "name"}, error) ||
      !bonus.HasColumns({"id", "title", "profile", "type"}, error) ||
      !accounts.HasColumns({"id", "email", "pin", "password", "device_limit", "cc_last_four", "cc_type_id",
                            "cc_type", "prepaid_cents", "adult_pin", "adult_verification", "country",
                            "audio_default"}, error) ||
      !gifts.HasColumns({"code", "cents"}, error) || !config.HasColumns({"key", "value"}, error))
    return false;

  for (size_t row = 0; row < genres.Size(); ++row) {
    VLSimGenre genre;
    if (!genres.Int(row, "id", &genre.id, error) || !genres.Int(row, "parent", &genre.parent, error) ||
        !genres.Bool(row, "visible", &genre.visible, error))
      return false;
    genre.name = genres.Get(row, "name");
    genre.labelMessage = genres.Get(row, "label_message");
    if (FindGenre(genre.id)) return genres.Fail(genres.Line(row), "genre " + std::to_string(genre.id) + " twice", error);
    m_Genres.push_back(genre);
  }
  for (size_t row = 0; row < genres.Size(); ++row)
    if (m_Genres[row].parent != 0 && !FindGenre(m_Genres[row].parent))
      return genres.Fail(genres.Line(row), "unknown parent genre", error);

  for (size_t row = 0; row < titles.Size(); ++row) {
    VLSimTitle title;
    const std::string& kind = titles.Get(row, "kind");
    if (!titles.Int(row, "id", &title.id, error) || !titles.Int(row, "user_rating", &title.userRating, error) ||
        !titles.Bool(row, "thx", &title.thx, error) || !titles.Bool(row, "thx_trailer", &title.thxTrailer, error))
      return false;
    if (kind != "movie" && kind != "tv") return titles.Fail(titles.Line(row), "kind must be movie or tv", error);
    if (FindTitle(title.id)) return titles.Fail(titles.Line(row), "title " + std::to_string(title.id) + " twice", error);
    title.tv = kind == "tv";
    title.name = titles.Get(row, "name");
    title.boxArt = titles.Get(row, "boxart");
    for (const std::string& id : Table::Split(titles.Get(row, "genres"), ',')) {
      int genre = atoi(id.c_str());
      if (!FindGenre(genre)) return titles.Fail(titles.Line(row), "unknown genre \"" + id + "\"", error);
      title.genres.push_back(genre);
    }
    if (title.genres.empty() || title.boxArt.empty())
      return titles.Fail(titles.Line(row), "a title needs a genre and a box-art prefix", error);
    title.mpaa = titles.Get(row, "mpaa");
    title.chvrs = titles.Get(row, "chvrs");
    title.ratingReason = titles.Get(row, "rating_reason");
    title.runtime = titles.Get(row, "runtime");
    title.directors = titles.Get(row, "directors");
    title.actors = titles.Get(row, "actors");
    title.writers = titles.Get(row, "writers");
    title.producers = titles.Get(row, "producers");
    title.copyright = titles.Get(row, "copyright");
    title.tivoId = titles.Get(row, "tivo_id");
    title.loyaltyBuy = titles.Get(row, "loyalty_buy");
    title.loyaltyRent = titles.Get(row, "loyalty_rent");
    title.synopsis = titles.Get(row, "synopsis");
    m_TitleIndex[title.id] = m_Titles.size();
    m_Titles.push_back(title);
  }

  for (size_t row = 0; row < episodes.Size(); ++row) {
    VLSimEpisode episode;
    if (!episodes.Int(row, "id", &episode.id, error) || !episodes.Int(row, "title", &episode.title, error) ||
        !episodes.Int(row, "number", &episode.number, error))
      return false;
    episode.name = episodes.Get(row, "name");
    const VLSimTitle* title = FindTitle(episode.title);
    if (!title || !title->tv) return episodes.Fail(episodes.Line(row), "the title is not a television series", error);
    if (!m_Episodes.emplace(episode.id, episode).second)
      return episodes.Fail(episodes.Line(row), "episode " + std::to_string(episode.id) + " twice", error);
    m_Titles[m_TitleIndex[episode.title]].episodes.push_back(episode.id);
  }
  for (VLSimTitle& title : m_Titles)
    std::sort(title.episodes.begin(), title.episodes.end(),
              [this](int a, int b) { return m_Episodes[a].number < m_Episodes[b].number; });

  for (size_t row = 0; row < products.Size(); ++row) {
    VLSimProduct product;
    const std::string& type = products.Get(row, "type");
    if (!products.Int(row, "sku", &product.sku, error) || !products.Int(row, "title", &product.title, error) ||
        !products.Int(row, "episode", &product.episode, error) ||
        !products.Int(row, "rental_hours", &product.rentalHours, error) ||
        !ParseEnumList(products, row, "profiles", soap_s2VL1__FileProfile, &product.profiles, error) ||
        !ParseEnumList(products, row, "audio", soap_s2VL1__AudioProfile, &product.audio, error))
      return false;
    if (type != "rent" && type != "buy") return products.Fail(products.Line(row), "type must be rent or buy", error);
    product.purchaseType = type == "rent" ? 0 : 1;
    product.price = products.Get(row, "price");
    product.expireDate = products.Get(row, "expire_date");
    if (!ParseCents(product.price, &product.priceCents))
      return products.Fail(products.Line(row), "price \"" + product.price + "\" is not a decimal like 3.99", error);
    if ((product.purchaseType == 0) != (product.rentalHours > 0))
      return products.Fail(products.Line(row), "rentals and only rentals have rental hours", error);
    if (!FindTitle(product.title)) return products.Fail(products.Line(row), "unknown title", error);
    if (product.episode) {
      const VLSimEpisode* episode = FindEpisode(product.episode);
      if (!episode || episode->title != product.title)
        return products.Fail(products.Line(row), "the episode does not belong to the title", error);
      m_Episodes[product.episode].products.push_back(product.sku);
    } else {
      m_Titles[m_TitleIndex[product.title]].products.push_back(product.sku);
    }
    if (!m_Products.emplace(product.sku, product).second)
      return products.Fail(products.Line(row), "SKU " + std::to_string(product.sku) + " twice", error);
  }

  for (size_t row = 0; row < bonus.Size(); ++row) {
    VLSimBonus asset;
    if (!bonus.Int(row, "id", &asset.id, error) || !bonus.Int(row, "title", &asset.title, error)) return false;
    if (!ParseEnum(soap_s2VL1__FileProfile, bonus.Get(row, "profile"), &asset.profile) ||
        !ParseEnum(soap_s2VL1__BonusAssetType, bonus.Get(row, "type"), &asset.type))
      return bonus.Fail(bonus.Line(row), "unknown profile or type", error);
    if (!FindTitle(asset.title)) return bonus.Fail(bonus.Line(row), "unknown title", error);
    if (!m_Bonus.emplace(asset.id, asset).second)
      return bonus.Fail(bonus.Line(row), "bonus asset " + std::to_string(asset.id) + " twice", error);
    m_Titles[m_TitleIndex[asset.title]].bonus.push_back(asset.id);
  }

  for (size_t row = 0; row < accounts.Size(); ++row) {
    VLSimAccountData account;
    if (!accounts.Int(row, "id", &account.id, error) || !accounts.Int(row, "device_limit", &account.deviceLimit, error) ||
        !accounts.Int(row, "prepaid_cents", &account.prepaidCents, error) ||
        !accounts.Int(row, "country", &account.country, error) ||
        !accounts.Bool(row, "adult_verification", &account.adultVerification, error))
      return false;
    if (!ParseEnum(soap_s2VL1__AudioProfile, accounts.Get(row, "audio_default"), &account.audioDefault))
      return accounts.Fail(accounts.Line(row), "unknown audio_default", error);
    account.email = accounts.Get(row, "email");
    account.pin = accounts.Get(row, "pin");
    account.password = accounts.Get(row, "password");
    account.ccLastFour = accounts.Get(row, "cc_last_four");
    account.ccType = accounts.Get(row, "cc_type");
    account.adultPin = accounts.Get(row, "adult_pin");
    if (!account.ccLastFour.empty() && !accounts.Int(row, "cc_type_id", &account.ccTypeId, error)) return false;
    for (const VLSimAccountData& other : m_Accounts)
      if (other.id == account.id || other.pin == account.pin)
        return accounts.Fail(accounts.Line(row), "account ID or PIN used twice", error);
    m_Accounts.push_back(account);
  }

  for (size_t row = 0; row < gifts.Size(); ++row) {
    int cents = 0;
    if (!gifts.Int(row, "cents", &cents, error)) return false;
    m_Gifts.push_back({gifts.Get(row, "code"), cents});
  }
  for (size_t row = 0; row < config.Size(); ++row) m_Config.push_back({config.Get(row, "key"), config.Get(row, "value")});
  return true;
}

const VLSimGenre* VLSimCatalogue::FindGenre(int id) const {
  for (const VLSimGenre& genre : m_Genres)
    if (genre.id == id) return &genre;
  return nullptr;
}

const VLSimTitle* VLSimCatalogue::FindTitle(int id) const {
  auto it = m_TitleIndex.find(id);
  return it == m_TitleIndex.end() ? nullptr : &m_Titles[it->second];
}

const VLSimProduct* VLSimCatalogue::FindProduct(int sku) const {
  auto it = m_Products.find(sku);
  return it == m_Products.end() ? nullptr : &it->second;
}

const VLSimEpisode* VLSimCatalogue::FindEpisode(int id) const {
  auto it = m_Episodes.find(id);
  return it == m_Episodes.end() ? nullptr : &it->second;
}

const VLSimBonus* VLSimCatalogue::FindBonus(int id) const {
  auto it = m_Bonus.find(id);
  return it == m_Bonus.end() ? nullptr : &it->second;
}

const VLSimTitle* VLSimCatalogue::FindTivo(const std::string& tivoId) const {
  for (const VLSimTitle& title : m_Titles)
    if (!tivoId.empty() && strcasecmp(title.tivoId.c_str(), tivoId.c_str()) == 0) return &title;
  return nullptr;
}

bool VLSimCatalogue::HasBoxArt(const std::string& prefix) const {
  for (const VLSimTitle& title : m_Titles)
    if (title.boxArt == prefix) return true;
  return false;
}

std::vector<const VLSimTitle*> VLSimCatalogue::TitlesInGenre(int genre) const {
  std::set<int> wanted = {genre};
  for (bool grew = true; grew;) {
    grew = false;
    for (const VLSimGenre& candidate : m_Genres)
      if (wanted.count(candidate.parent) && wanted.insert(candidate.id).second) grew = true;
  }
  std::vector<const VLSimTitle*> found;
  for (const VLSimTitle& title : m_Titles)
    if (std::any_of(title.genres.begin(), title.genres.end(), [&](int id) { return wanted.count(id) > 0; }))
      found.push_back(&title);
  return found;
}

std::vector<const VLSimTitle*> VLSimCatalogue::Search(const std::string& query, bool detail) const {
  std::vector<const VLSimTitle*> found;
  for (const VLSimTitle& title : m_Titles) {
    if (ContainsNoCase(title.name, query) ||
        (detail && (ContainsNoCase(title.synopsis, query) || ContainsNoCase(title.actors, query) ||
                    ContainsNoCase(title.directors, query))))
      found.push_back(&title);
  }
  return found;
}

std::vector<const VLSimTitle*> VLSimCatalogue::Recommendations(int id) const {
  std::vector<const VLSimTitle*> found;
  const VLSimTitle* source = FindTitle(id);
  if (!source) return found;
  for (int genre : source->genres) {
    for (const VLSimTitle& title : m_Titles) {
      if (found.size() == 10) return found;
      if (title.id != id && std::find(title.genres.begin(), title.genres.end(), genre) != title.genres.end() &&
          std::find(found.begin(), found.end(), &title) == found.end())
        found.push_back(&title);
    }
  }
  return found;
}
