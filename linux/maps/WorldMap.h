#pragma once

#include <cstdint>
#include <filesystem>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include <QPointF>
#include <QRectF>

namespace ktr::linux_ {

/// The shores, borders, countries and towns of the world as `scripts/make-world-map` writes them (docs/maps.md has the
/// format). Places are in Web Mercator, the world a square of side 1 with its origin at the top left. Any thread.
class WorldMap {
  public:
    /// A line, in stretches of at most kStretch points that each know where they are. Stretches share no points. One
    /// that crosses the date line goes on beyond the square; what reaches the pole does so at y = 3.
    struct Line {
        static constexpr std::size_t kStretch = 64;
        std::vector<QPointF> points;
        QRectF bounds;
        std::vector<QRectF> stretches;
    };
    /// The world in as much detail as makes sense up to a zoom.
    struct Level {
        double zoom = 0.0;
        std::vector<Line> shores;   ///< closed; land to be filled by the odd-even rule
        std::vector<Line> borders;  ///< open
    };
    struct Country {
        QPointF middle;
        int number = 0;     ///< ISO 3166-1 numeric; 0 for one without
        double zoom = 0.0;  ///< from which on the name fits
        std::string name;   ///< in English
    };
    struct Town {
        QPointF place;
        double zoom = 0.0;
        bool isCapital = false;
        std::string name;  ///< in English
        std::string zone;  ///< the time zone that bears its name; may be empty
    };

    /// Mainland China, for the datum that is in use there alone. All lines are open; the first three together are its
    /// outline.
    struct Outline {
        std::vector<Line> coasts;
        std::vector<Line> borders;
        std::vector<Line> cityBorders;    ///< with Hong Kong and Macau
        std::vector<Line> foreignShores;  ///< of others, near its coasts
    };

    /// None, and a reason, when the file cannot be read or is damaged.
    static std::shared_ptr<const WorldMap> read(const std::filesystem::path& file, std::string& reason);
    /// The same; none is an error line in the log, with the reason, what is missing for it and what to do.
    static std::shared_ptr<const WorldMap> readOrReport(const std::filesystem::path& file, std::string_view missing);
    static std::shared_ptr<const WorldMap> parse(const std::vector<unsigned char>& data, std::string& reason);

    const Level& levelFor(double zoom) const;
    const std::vector<Level>& levels() const { return levels_; }
    const std::vector<Country>& countries() const { return countries_; }
    const std::vector<Town>& towns() const { return towns_; }
    const Outline& outline() const { return outline_; }

  private:
    class Reader;
    std::vector<Level> levels_;
    std::vector<Country> countries_;
    std::vector<Town> towns_;
    Outline outline_;
};

}  // namespace ktr::linux_
