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

/// The progress of a search in a document.
struct SearchState {
    std::size_t matches = 0;
    std::size_t current = 0; ///< counted from 1; 0: no match is marked
    bool isComplete = true;
    bool operator==(const SearchState&) const = default;
};

/// Calls down that a preview makes to its peer. Main thread.
class PreviewViewObserver {
public:
    virtual ~PreviewViewObserver() = default;
    virtual void previewContentDidChange() { } ///< the content or its size
    virtual void previewNeedsDisplay() { } ///< only its look
    virtual void previewZoomDidChange() { }
    virtual void previewQueryDidChange() { }
    virtual void previewShouldShowMatch(MatchStep) { }
    virtual void previewShouldScrollTo(const Rect& /*place in the content*/) { }
    virtual void previewShouldStop() { } ///< it is no longer visible, so playing stops
    virtual void previewShouldTakeFocus() { }
    virtual void previewShouldCopy() { } ///< copies the selection to the clipboard
};

/// The view of a document's content, and the commands of its toolbar and keys. The host makes the peer by
/// the kind. New content of the same kind is put into the same view, which keeps place, zoom and search.
/// Main thread only.
class PreviewView : public kit::HostedView {
public:
    using kit::HostedView::HostedView;

    void setPreviewObserver(std::weak_ptr<PreviewViewObserver> observer) { _peer.set(std::move(observer)); }

    virtual bool canZoom() const { return false; }
    virtual bool canSearch() const { return false; }
    /// Answers whether something is selected that the peer does not copy by itself.
    virtual bool canCopy() const { return false; }

    static constexpr double minZoom = 1, maxZoom = 12; ///< 1 fits the window
    static constexpr double zoomStep = 1.5; ///< factor of one press of a button or key
    double zoom() const { return _zoom; }
    void setZoom(double zoom); ///< by the program; kept within the limits
    void userZoomed(double zoom); ///< event up: the peer now shows this zoom

    const std::string& query() const { return _query; }
    /// Searches for a text regardless of case and marks the first match after the visible place. An empty
    /// text ends the search.
    void setQuery(std::string query);
    virtual void showMatch(MatchStep step);
    const SearchState& searchState() const { return _search; }
    void setSearchState(const SearchState& state);

    void stop(); ///< it is no longer visible
    void takeFocus();
    void copy();

    /// The callback runs after every change that a toolbar shows.
    void setOnStateChange(std::function<void()> callback) { _onStateChange = std::move(callback); }
    /// The callback runs when the user presses the keys that begin a search.
    void setOnFind(std::function<void()> callback) { _onFind = std::move(callback); }
    void userWantsToFind();
    /// The callback runs with a sentence when the peer cannot show the content.
    void setOnFailure(std::function<void(const std::string&)> callback) { _onFailure = std::move(callback); }
    void peerFailed(const std::string& words);

protected:
    virtual void queryDidChange() { }
    const kit::ObserverSlot<PreviewViewObserver>& peer() const { return _peer; }
    void stateDidChange();

private:
    kit::ObserverSlot<PreviewViewObserver> _peer;
    double _zoom = minZoom;
    std::string _query;
    SearchState _search;
    std::function<void()> _onStateChange, _onFind;
    std::function<void(const std::string&)> _onFailure;
};

} // namespace screens
