"""The names of the demo town's main places in German, Arabic and Japanese; the others have one name."""

_NAMES = {
    "Brinmouth": ("Brinmouth", "برينماوث", "ブリンマス"),
    "Harbour": ("Hafen", "الميناء", "港"),
    "Old Harbour": ("Alter Hafen", "الميناء القديم", "旧港"),
    "Brin Bay": ("Brinbucht", "خليج برين", "ブリン湾"),
    "River Brin": ("Brin", "نهر برين", "ブリン川"),
    "Fish Market": ("Fischmarkt", "سوق السمك", "魚市場"),
    "Ferry Pier": ("Fähranleger", "رصيف العبّارات", "フェリー桟橋"),
    "Lantern Park": ("Laternenpark", "حديقة الفانوس", "ランタン公園"),
    "Priory Gardens": ("Prioratsgärten", "حدائق الدير", "修道院庭園"),
    "Lamp Square": ("Lampenplatz", "ساحة المصباح", "ランプ広場"),
    "Brinmouth Station": ("Bahnhof Brinmouth", "محطة برينماوث", "ブリンマス駅"),
    "Quay Road": ("Kaistraße", "طريق المرفأ", "埠頭通り"),
    "Fish Quay": ("Fischkai", "رصيف السمك", "魚河岸"),
    "Ropewalk": ("Seilerbahn", "ممشى الحبال", "縄ない小路"),
    "Lantern Street": ("Laternenstraße", "شارع الفانوس", "ランタン通り"),
    "Mill Lane": ("Mühlgasse", "زقاق الطاحونة", "水車小路"),
    "Tanner Row": ("Gerberzeile", "صف الدباغين", "皮なめし通り"),
    "Station Road": ("Bahnhofstraße", "طريق المحطة", "駅前通り"),
    "Market Street": ("Marktstraße", "شارع السوق", "市場通り"),
    "Salt Lane": ("Salzgasse", "زقاق الملح", "塩小路"),
    "Sail Lane": ("Segelgasse", "زقاق الشراع", "帆小路"),
    "Church Street": ("Kirchstraße", "شارع الكنيسة", "教会通り"),
    "Hill Street": ("Hügelstraße", "شارع التل", "丘通り"),
    "Pilot Street": ("Lotsenstraße", "شارع المرشد", "水先案内通り"),
    "Water Lane": ("Wassergasse", "زقاق الماء", "水小路"),
    "Town Hall": ("Rathaus", "مبنى البلدية", "市庁舎"),
    "Library": ("Bibliothek", "المكتبة", "図書館"),
    "Harbour Hospital": ("Hafenkrankenhaus", "مستشفى الميناء", "港病院"),
    "Lifeboat Museum": ("Seenotrettungsmuseum", "متحف قوارب النجاة", "救命艇博物館"),
}


def named(name):
    """A feature's names as attributes."""
    names = {"name": name, "name_en": name}
    if name in _NAMES:
        names.update(zip(("name_de", "name_ar", "name_ja"), _NAMES[name]))
    return names
