# Every dependency is a Debian package installed by scripts/setup.
find_package(PkgConfig REQUIRED)
find_package(Boost 1.74 REQUIRED)
pkg_check_modules(VELK_ICU REQUIRED IMPORTED_TARGET icu-uc icu-i18n)
pkg_check_modules(VELK_EXPAT REQUIRED IMPORTED_TARGET expat)
pkg_check_modules(VELK_CAIRO REQUIRED IMPORTED_TARGET cairo)
pkg_check_modules(VELK_PANGO REQUIRED IMPORTED_TARGET pango pangocairo pangoft2 fontconfig)
pkg_check_modules(VELK_X11 REQUIRED IMPORTED_TARGET x11 xtst xrandr cairo-xlib)
