#pragma once

#include <QTimer>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "app/window/blocks/Button.h"
#include "app/window/friend/FriendMap.h"
#include "app/window/friend/FriendSheet.h"
#include "app/window/friend/MapControls.h"
#include "app/window/pages/Page.h"
#include "host/Host.h"
#include "host/links/KnownFriends.h"

namespace ktr::app {

/// A friend: a large map to move about in, where they are, and what can be done. The place is kept up to date as a
/// card's is. Main thread.
class FriendPage : public Page {
  public:
    enum class Asks {
        AtOnce,    ///< the user has asked about this friend
        OnlyOnTap  ///< another program has sent the user here
    };
    /// Opens a link that this page has made; with the key of the words for when nobody opens it.
    using Open = std::function<void(const std::string& url, const char* nobody)>;

    /// The host outlives the page. `getStreets` leads to where a map is added; empty: nothing is said of streets.
    FriendPage(host::Host& host, host::KnownFriends::Known known, Asks asks, Open open,
               std::function<void()> getStreets);
    ~FriendPage() override;

    QString name() const override;
    QWidget* firstFocus() const override { return map_; }

    FriendMap& map() const { return *map_; }
    FriendSheet& sheet() const { return *sheet_; }
    MapControls& zoom() const { return *zoom_; }
    Button& showAgain() const { return *again_; }
    IconButton& back() const { return *back_; }
    /// Lets go of everything that is the installed platform's; `refresh` makes it anew.
    void letGo() override;
    /// Whether a question about these handles is this page's.
    bool asksAbout(const std::vector<std::string>& handles) const;

  protected:
    void resizeEvent(QResizeEvent* event) override;
    bool event(QEvent* event) override;
    void lookChanged() override;
    void refreshed() override;

  private:
    void ask();
    void build();
    void setTexts();
    void mapChanged();
    void takeNewest();
    void showPlace();
    void chooseActions();
    void copyPlace();
    void place();
    void placeControls(const QRect& sheet, bool isBeside);
    QString text(const char* key) const;
    QString textWith(const char* key, const std::string& argument) const;
    QString whereWords() const;
    QString howExactlyWords() const;

    host::Host& host_;
    host::KnownFriends::Known known_;
    bool isAsked_;
    const Open open_;
    const std::function<void()> getStreets_;
    FriendMap* map_;
    FriendSheet* sheet_;
    MapControls* leave_;
    IconButton* back_;
    MapControls* zoom_;
    IconButton* closer_;
    IconButton* further_;
    Button* again_;
    QTimer copied_;
    int copyAction_ = -1;
};

}  // namespace ktr::app
