// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewEditing.h"

#include "platform/CopyName.h"
#include "platform/Dispatch.h"
#include "platform/FileCoordinator.h"
#include "platform/Services.h"

#include <algorithm>
#include <deque>
#include <mutex>
#include <utility>

namespace screens {

namespace {

constexpr int mostCopies = 1000; ///< copies of one document
/// Nobody fills in a form of more pages by hand, so its fields are not read.
constexpr std::size_t mostPagesOfForm = 2000;

} // namespace

/// The work that runs on the queue. Waiting steps keep it alive, so that no requested step is lost.
class PreviewEditing::Work : public std::enable_shared_from_this<Work> {
public:
    Work(FileContent content, std::shared_ptr<PagedDocumentEditing> edited)
        : document(std::move(edited))
        , _content(std::move(content))
    {
    }

    void post(std::function<void()> step)
    {
        {
            const std::lock_guard lock(_mutex);
            _waiting.push_back(std::move(step));
        }
        _queue->async([self = shared_from_this()] { self->runNext(); });
    }

    /// Runs the waiting steps on this thread.
    void finish()
    {
        while (runNext()) { }
    }

    std::optional<Error> apply(unsigned number, const PageEdit& edit)
    {
        auto error = document->apply(edit);
        if (!error)
            _steps.push_back(number);
        return error;
    }

    /// Takes an edit back unless it was refused. The edit before it would be taken back in its place.
    void undo(unsigned number)
    {
        if (lastStep() != number)
            return;
        document->undo();
        _steps.pop_back();
    }

    /// Answers the number of the last edit in force, or 0.
    unsigned lastStep() const { return _steps.empty() ? 0 : _steps.back(); }

    EditsKept keep(EditsPlace place, const Url& item)
    {
        const auto written = document->written();
        if (!written)
            return {EditsKept::Where::Nowhere, item, written.error};
        return place == EditsPlace::Document ? save(item, *written.value)
                                             : writeCopy(item, *written.value, 1);
    }

    bool isChanged(const Url& item) const
    {
        bool isSame = false;
        services().fileCoordinator().coordinateReading(
            item, ReadingOptions::ImmediatelyAvailableMetadataOnly, [&](const Url& location) {
                auto version = services().fileChanges().versionOfItem(location.path());
                if (version)
                    version->changed = _content.version.changed; // a changed tag is not a changed content
                isSame = version == _content.version;
            });
        return !isSame;
    }

    const ItemVersion& version() const { return _content.version; }

    /// Answers where the document is: at the other place, if it was moved there.
    Url placeOf(const Url& item, const std::optional<Url>& other) const
    {
        const auto moved = other ? services().fileChanges().versionOfItem(other->path()) : std::nullopt;
        const bool isThere =
            moved && moved->device == _content.version.device && moved->inode == _content.version.inode;
        return isThere ? *other : item;
    }

    const std::shared_ptr<PagedDocumentEditing> document;

private:
    bool runNext()
    {
        const std::lock_guard one(_running);
        std::function<void()> step;
        {
            const std::lock_guard lock(_mutex);
            if (_waiting.empty())
                return false;
            step = std::move(_waiting.front());
            _waiting.pop_front();
        }
        step();
        return true;
    }

    EditsKept save(const Url& item, const std::string& bytes)
    {
        Result<ItemVersion> replaced = Error(FileErrorCode::Cancelled);
        const auto refused = services().fileCoordinator().coordinateWriting(
            _copy.value_or(item), WritingOptions::ForReplacing, [&](const Url& location) {
                replaced = services().fileChanges().replaceContent(location.path(), _content, bytes);
            });
        if (refused)
            return {EditsKept::Where::Nowhere, item, refused};
        if (!replaced.value && replaced.error && replaced.error->is(FileErrorCode::Cancelled))
            return writeCopy(item, bytes, 2);
        if (!replaced.value)
            return {EditsKept::Where::Nowhere, item, replaced.error};
        _content = {std::make_shared<const std::string>(bytes), *replaced.value};
        return {_copy ? EditsKept::Where::Copy : EditsKept::Where::Document, _copy.value_or(item),
            std::nullopt, *replaced.value};
    }

    /// Writes a new document beside the original. The first copy has the original's own name, which is free
    /// when the original is gone. Later edits are saved in the copy.
    EditsKept writeCopy(const Url& item, const std::string& bytes, int firstNumber)
    {
        const auto folder = item.deletingLastPathComponent();
        std::optional<Error> error;
        for (int number = firstNumber; number <= mostCopies; ++number) {
            const auto copy =
                folder.appendingPathComponent(platform::copyName(item.lastPathComponent(), number));
            const auto refused = services().fileCoordinator().coordinateWriting(
                copy, WritingOptions::None, [&](const Url& location) {
                    error = services().fileChanges().addDocument(location.path(), item.path(), bytes);
                });
            if (refused)
                return {EditsKept::Where::Nowhere, copy, refused};
            if (!error) {
                _copy = copy;
                // Without a version the next save compares the bytes.
                _content = {std::make_shared<const std::string>(bytes), {}};
                return {EditsKept::Where::Copy, copy, std::nullopt};
            }
            if (!error->is(FileErrorCode::ItemExists))
                break;
        }
        return {EditsKept::Where::Nowhere, item, error};
    }

    std::shared_ptr<Queue> _queue = services().dispatch().makeSerialQueue("preview editing");
    std::mutex _running; ///< locked while a step runs
    std::mutex _mutex;
    std::deque<std::function<void()>> _waiting;
    // Only steps use these.
    FileContent _content; ///< the content on the disk at the last look
    std::optional<Url> _copy; ///< where the edits are since they could not be kept in the document
    std::vector<unsigned> _steps; ///< numbers of the edits in force, in their order
};

void PreviewEditing::begin(const Url& item, Opened opened)
{
    const auto queue = services().dispatch().makeSerialQueue("preview editing");
    queue->async([queue, item, opened = std::move(opened), main = services().dispatch().mainQueue()] {
        Result<FileContent> content = Error(FileErrorCode::NoSuchItem);
        auto error = services().fileCoordinator().coordinateReading(
            item, ReadingOptions::ImmediatelyAvailableMetadataOnly, [&](const Url& location) {
                content = services().fileChanges().contentToReplace(
                    location.path(), PagedDocumentEditing::maxBytes);
            });
        if (!error && !content)
            error = content.error;
        Result<std::shared_ptr<PagedDocumentEditing>> document =
            error.value_or(Error(FileErrorCode::NoSuchItem));
        if (!error)
            document = services().pagedDocumentOpener().openForEditing(content->bytes);
        main->async([item, opened, content = std::move(content), document = std::move(document)] {
            if (!document)
                return opened(*document.error);
            opened(std::shared_ptr<PreviewEditing>(std::make_shared<PreviewEditing>(
                item, std::make_shared<Work>(*content.value, *document.value))));
        });
    });
}

PreviewEditing::PreviewEditing(Url item, std::shared_ptr<Work> work)
    : _item(std::move(item))
    , _work(std::move(work))
    , _pages(_work->document->pages())
    , _rights(_pages->rights())
    , _versionRead(_work->version())
{
}

/// Runs a step on the queue and the step's answer on the main thread.
void PreviewEditing::post(std::function<std::function<void()>()> step)
{
    _work->post([step = std::move(step), main = services().dispatch().mainQueue()] { main->async(step()); });
}

void PreviewEditing::apply(PageEdit edit, Stepped done)
{
    _steps.push_back(++_lastStep);
    post([self = shared_from_this(), number = _lastStep, work = _work, edit = std::move(edit),
             done = std::move(done)]() -> std::function<void()> {
        return [self, number, done, error = work->apply(number, edit)] {
            if (error)
                std::erase(self->_steps, number);
            done(error);
        };
    });
}

void PreviewEditing::undo(Stepped done)
{
    if (_steps.empty())
        return;
    const auto number = _steps.back();
    _steps.pop_back();
    post([work = _work, number, done = std::move(done)]() -> std::function<void()> {
        work->undo(number);
        return [done] { done(std::nullopt); };
    });
}

void PreviewEditing::readFields(std::function<void(std::vector<FormField>)> completion)
{
    post([work = _work, completion = std::move(completion)]() -> std::function<void()> {
        std::vector<FormField> fields;
        const auto count = std::min(work->document->pages()->pageCount(), mostPagesOfForm);
        for (std::size_t page = 0; page < count; ++page) {
            for (auto& field : work->document->fields(page))
                fields.push_back(std::move(field));
        }
        return [completion, fields = std::move(fields)] { completion(fields); };
    });
}

void PreviewEditing::checkItem(std::function<void(bool)> completion)
{
    post([work = _work, item = _item, completion = std::move(completion)]() -> std::function<void()> {
        return [completion, isChanged = work->isChanged(item)] { completion(isChanged); };
    });
}

void PreviewEditing::save(Kept kept)
{
    keep(EditsPlace::Document, std::move(kept));
}

void PreviewEditing::saveCopy(Kept kept)
{
    keep(EditsPlace::Copy, std::move(kept));
}

void PreviewEditing::keep(EditsPlace place, Kept kept)
{
    ++_savesUnderWay;
    post([self = shared_from_this(), work = _work, item = _item, other = _otherPlace, place,
             kept = std::move(kept)]() -> std::function<void()> {
        return
            [self, step = work->lastStep(), kept, outcome = work->keep(place, work->placeOf(item, other))] {
                --self->_savesUnderWay;
                if (outcome.where != EditsKept::Where::Nowhere)
                    self->_kept = step;
                kept(outcome);
            };
    });
}

EditsKept PreviewEditing::keepNow(EditsPlace place)
{
    _work->finish();
    auto outcome = _work->keep(place, _work->placeOf(_item, _otherPlace));
    if (outcome.where != EditsKept::Where::Nowhere)
        _kept = current();
    return outcome;
}

} // namespace screens
