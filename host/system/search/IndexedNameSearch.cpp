// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/search/IndexedNameSearch.h"

#include "host/system/search/NameGathering.h"
#include "platform/Weakly.h"

#include <algorithm>
#include <atomic>
#include <chrono>
#include <mutex>
#include <optional>
#include <utility>

namespace host::system {

using platform::NameSearchResults;
using platform::Url;
using platform::weakly;

namespace {

using Index = std::shared_ptr<const NameIndex>;

constexpr auto refreshInterval = std::chrono::seconds(2);
constexpr auto keptUnused = std::chrono::seconds(60);
constexpr int restAfterTags = 20; ///< a look at all tags is followed by so many times its duration

std::vector<std::string> pathsOf(const std::vector<Url>& folders)
{
    std::vector<std::string> paths;
    paths.reserve(folders.size());
    for (const auto& folder : folders)
        paths.push_back(folder.path());
    return paths;
}

} // namespace

/// The state that all searches share: the index of the last search, and the queues.
class IndexedNameSearch::Store : public std::enable_shared_from_this<Store> {
public:
    Store(std::shared_ptr<platform::Dispatch> usedDispatch, std::shared_ptr<const MimeTypeRegistry> types,
        const Tags& tags)
        : dispatch(std::move(usedDispatch))
        , classifier(std::move(types))
        , readTags(tags.reader)
        , reading(dispatch->makeSerialQueue("name search reading"))
        , finding(dispatch->makeSerialQueue("name search"))
    {
        for (const auto& prefix : tags.prefixes) {
            auto& text = _tagPrefixes.emplace_back();
            folding.append(prefix, text);
        }
    }

    /// Answers the beginning of the tag that a folded query asks for, or nothing when it asks for names.
    std::optional<std::string_view> tagAskedFor(std::string_view foldedQuery) const
    {
        const auto prefix = std::ranges::find_if(
            _tagPrefixes, [&](const std::string& text) { return foldedQuery.starts_with(text); });
        if (prefix == _tagPrefixes.end())
            return std::nullopt;
        foldedQuery.remove_prefix(prefix->size());
        foldedQuery.remove_prefix(std::min(foldedQuery.find_first_not_of(' '), foldedQuery.size()));
        return foldedQuery;
    }

    /// Answers the index of exactly these roots, or null when it is not kept.
    Index indexOf(const std::vector<std::string>& roots)
    {
        const std::lock_guard lock(_mutex);
        return roots == _roots ? _index : nullptr;
    }
    void keep(const std::vector<std::string>& roots, Index index)
    {
        const std::lock_guard lock(_mutex);
        _roots = roots;
        _index = std::move(index);
    }
    void sessionBegan() { ++_sessions; }
    void sessionEnded()
    {
        --_sessions;
        dispatch->after(keptUnused, reading, weakly(this, [number = ++_ended](Store& self) {
            if (self._sessions == 0 && self._ended == number)
                self.keep({}, nullptr);
        }));
    }

    const std::shared_ptr<platform::Dispatch> dispatch;
    const EntryClassifier classifier;
    const NameFolding folding;
    const TagIndex::Reader readTags;
    const std::shared_ptr<platform::Queue> reading, finding;

private:
    std::mutex _mutex;
    std::vector<std::string> _roots;
    Index _index;
    std::vector<std::string> _tagPrefixes; ///< folded
    std::atomic<int> _sessions = 0;
    std::atomic<unsigned> _ended = 0;
};

class IndexedNameSearch::Session : public platform::NameSearchSession,
                                   public std::enable_shared_from_this<Session> {
public:
    Session(std::shared_ptr<Store> store, std::vector<std::string> roots, Update update)
        : _store(std::move(store))
        , _roots(std::move(roots))
        , _update(std::move(update))
        , _index(_store->indexOf(_roots))
    {
        _store->sessionBegan();
    }
    ~Session() override { _store->sessionEnded(); }

    void setQuery(std::string query) override
    {
        {
            const std::lock_guard lock(_mutex);
            _query = std::move(query);
            ++_generation;
        }
        findSoon();
    }

    void refreshSoon()
    {
        _store->reading->async([weak = weak_from_this()] {
            const auto session = weak.lock();
            const auto store = session ? session->_store : nullptr;
            const auto earlier = session ? session->index() : nullptr;
            const auto roots = session ? session->_roots : std::vector<std::string>();
            if (store)
                refresh(weak, *store, roots, earlier);
        });
    }

private:
    using Weak = std::weak_ptr<Session>;

    Index index()
    {
        const std::lock_guard lock(_mutex);
        return _index;
    }

    /// Reads the names without keeping the session alive, so that destroying the session ends the reading.
    static void refresh(
        const Weak& weak, Store& store, const std::vector<std::string>& roots, const Index& earlier)
    {
        NameGathering gathering(store.classifier, store.folding, earlier,
            {.isCancelled = [&weak] { return weak.expired(); },
                .progress = weakly(weak, [](Session& self, const NameIndex& soFar) {
                    self.adopt(std::make_shared<const NameIndex>(soFar), false);
                })});
        auto gathered = gathering.gather(roots);
        const auto session = weak.lock();
        if (!session)
            return;
        if (gathering.hasChanged() || !earlier)
            session->adopt(std::make_shared<const NameIndex>(std::move(gathered)), true);
        else
            session->completed();
        store.dispatch->after(refreshInterval, store.reading, weakly(weak, &Session::refreshSoon));
    }

    void adopt(Index index, bool isComplete)
    {
        if (isComplete)
            _store->keep(_roots, index);
        {
            const std::lock_guard lock(_mutex);
            _index = std::move(index);
            _isComplete = isComplete;
        }
        findSoon();
    }

    void completed()
    {
        {
            const std::lock_guard lock(_mutex);
            if (std::exchange(_isComplete, true))
                return;
        }
        findSoon();
    }

    void findSoon()
    {
        if (_findIsWaiting.exchange(true))
            return;
        _store->finding->async(weakly(this, &Session::find));
    }

    void find()
    {
        _findIsWaiting = false;
        NameSearchResults results;
        Index index;
        unsigned generation = 0;
        {
            const std::lock_guard lock(_mutex);
            index = _index;
            results.query = _query;
            results.isComplete = _isComplete;
            generation = _generation;
        }
        if (!index)
            return;
        std::string folded;
        _store->folding.append(results.query, folded);
        if (const auto tag = _store->tagAskedFor(folded))
            findTagged(*tag, index, results);
        else
            take(index->find(folded, shownItems, [&] { return _generation != generation; }), *index, results);
        _store->dispatch->mainQueue()->async(
            weakly(this, [generation, results = std::move(results)](Session& self) {
                if (self._generation == generation)
                    self._update(results);
            }));
    }

    static void take(const NameIndex::Found& found, const NameIndex& index, NameSearchResults& results)
    {
        results.total = found.total;
        for (const auto number : found.items)
            results.items.push_back(index.found(number));
    }

    /// Answers what is known of the items with a tag. When the names are others by now, their tags are looked
    /// at.
    void findTagged(std::string_view tag, const Index& index, NameSearchResults& results)
    {
        results.isForTag = true;
        const auto tags = this->tags();
        const bool isKnown = tags && &tags->names() == index.get();
        if (tags)
            take(tags->find(tag, shownItems), tags->names(), results);
        if (results.isComplete && !isKnown)
            gatherTagsSoon();
        results.isComplete = results.isComplete && isKnown;
    }

    std::shared_ptr<const TagIndex> tags()
    {
        const std::lock_guard lock(_mutex);
        return _tags;
    }

    void gatherTagsSoon()
    {
        if (!_gathersTags.exchange(true))
            _store->reading->async([weak = weak_from_this()] { gatherTags(weak); });
    }

    /// Looks at the tags without keeping the session alive, as refresh() does.
    static void gatherTags(const Weak& weak)
    {
        auto session = weak.lock();
        if (!session)
            return;
        const auto store = session->_store;
        const auto index = session->index();
        session.reset();
        const auto began = std::chrono::steady_clock::now();
        auto tags = std::make_shared<const TagIndex>(
            TagIndex::gather(index, store->readTags, store->folding, [&weak] { return weak.expired(); }));
        session = weak.lock();
        if (!session)
            return;
        const auto duration = std::chrono::steady_clock::now() - began;
        const auto rest = std::max<std::chrono::nanoseconds>(refreshInterval, duration * restAfterTags);
        session->adoptTags(std::move(tags));
        store->dispatch->after(std::chrono::duration_cast<std::chrono::milliseconds>(rest), store->reading,
            weakly(weak, [round = ++session->_tagRounds](Session& self) {
                if (self._tagRounds == round && self.asksForTag())
                    self.gatherTagsSoon();
            }));
    }

    void adoptTags(std::shared_ptr<const TagIndex> tags)
    {
        {
            const std::lock_guard lock(_mutex);
            _tags = std::move(tags);
        }
        _gathersTags = false;
        findSoon();
    }

    bool asksForTag()
    {
        std::string folded;
        {
            const std::lock_guard lock(_mutex);
            _store->folding.append(_query, folded);
        }
        return _store->tagAskedFor(folded).has_value();
    }

    const std::shared_ptr<Store> _store;
    const std::vector<std::string> _roots;
    const Update _update;
    std::atomic<unsigned> _generation = 0; ///< number of the query
    std::atomic<bool> _findIsWaiting = false, _gathersTags = false;
    std::atomic<unsigned> _tagRounds = 0; ///< number of looks at all tags
    std::mutex _mutex; ///< guards the fields below
    Index _index; ///< null until names are known
    std::shared_ptr<const TagIndex> _tags; ///< null until tags are searched for
    std::string _query;
    bool _isComplete = false;
};

IndexedNameSearch::IndexedNameSearch(std::shared_ptr<platform::Dispatch> dispatch,
    std::shared_ptr<const MimeTypeRegistry> types, const Tags& tags)
    : _store(std::make_shared<Store>(std::move(dispatch), std::move(types), tags))
{
}

IndexedNameSearch::~IndexedNameSearch() = default;

std::shared_ptr<platform::NameSearchSession> IndexedNameSearch::begin(std::vector<Url> folders, Update update)
{
    const auto session = std::make_shared<Session>(_store, pathsOf(folders), std::move(update));
    session->refreshSoon();
    return session;
}

} // namespace host::system
