/// The language of the texts: catalogues, locale, reading direction.
#pragma once

namespace app_assist {

class Language {
 public:
  /// Every catalogue under the application's resources, and the platform's own.
  static void bindCatalogues();
  /// The language of the settings, else that of the environment; before there is a window.
  static void begin();
  /// All texts that know their message id follow, in every open window.
  static void change();
};

}  // namespace app_assist
