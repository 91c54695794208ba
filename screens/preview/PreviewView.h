// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ObserverSlot.h"
#include "kit/views/HostedView.h"
#include "platform/Geometry.h"
#include "screens/PlatformNames.h"

#include <cstddef>
#include <functional>
#include <memory>
#include <string>

namespace screens {

enum class MatchStep { Next, Previous };

/// How far a search in a document has come.
struct SearchState {
    std::size_t matches = 0;
    std::size_t current = 0; ///< counted from 1; 0: none is marked
    bool isComplete = true;
    bool operator==(const SearchState&) const = default;
};

/// The native view that shows a preview: calls down. Main thread.
class PreviewViewObserver {
public:
    virtual ~PreviewViewObserver() = default;
    virtual void previewContentDidChange() { } ///< what is shown, or how large it is
    virtual void previewNeedsDisplay() { } ///< nothing but how it looks
    virtual void previewZoomDidChange() { }
    virtual void previewQueryDidChange() { }
    virtual void previewShouldShowMatch(MatchStep) { }
    virtual void previewShouldScrollTo(const Rect& /*place in the content*/) { }
    virtual void previewShouldStop() { } ///< it is no longer seen: nothing plays on
    virtual void previewShouldTakeFocus() { }
    virtual void previewShouldCopy() { } ///< what is selected, to the clipboard
};

/// The view of a document's content, with what its toolbar and keys act on. The host makes the native view by
/// the kind. A new content of the same kind is put into the same view, which keeps place, zoom and search.
/// Main thread only.
class PreviewView : public kit::HostedView {
public:
    using kit::HostedView::HostedView;

    void setPreviewObserver(std::weak_ptr<PreviewViewObserver> observer) { _native.set(std::move(observer)); }

    virtual bool canZoom() const { return false; }
    virtual bool canSearch() const { return false; }
    /// Whether something is selected that only a command of ours copies.
    virtual bool canCopy() const { return false; }

    static constexpr double minZoom = 1, maxZoom = 12; ///< 1 fits the window
    static constexpr double zoomStep = 1.5; ///< of the buttons and keys
    double zoom() const { return _zoom; }
    void setZoom(double zoom); ///< by the program; kept within the limits
    void userZoomed(double zoom); ///< event up: the native view shows this zoom now

    const std::string& query() const { return _query; }
    /// Looks for a text, whatever its case; the first match after the place that is shown is marked. Empty:
    /// the search ends.
    void setQuery(std::string query);
    virtual void showMatch(MatchStep step);
    const SearchState& searchState() const { return _search; }
    void setSearchState(const SearchState& state);

    void stop(); ///< it is no longer seen
    void takeFocus();
    void copy();

    /// Called whenever what a toolbar shows of this view has changed.
    void setOnStateChange(std::function<void()> callback) { _onStateChange = std::move(callback); }
    /// Called when the person presses the keys that begin a search.
    void setOnFind(std::function<void()> callback) { _onFind = std::move(callback); }
    void userWantsToFind();
    /// Called with words when the native view finds that it cannot show the content.
    void setOnFailure(std::function<void(const std::string&)> callback) { _onFailure = std::move(callback); }
    void nativeFailed(const std::string& words);

protected:
    virtual void queryDidChange() { }
    const kit::ObserverSlot<PreviewViewObserver>& native() const { return _native; }
    void stateDidChange();

private:
    kit::ObserverSlot<PreviewViewObserver> _native;
    double _zoom = minZoom;
    std::string _query;
    SearchState _search;
    std::function<void()> _onStateChange, _onFind;
    std::function<void(const std::string&)> _onFailure;
};

} // namespace screens
