// The yardstick: a bare Elementary window with a bare gengrid of N cells, each one picture and
// nothing else. usage: bare_grid N LIST   (LIST: a text file with one picture's path per line; they
// are used in turn)

#include <Elementary.h>

#include <cstdlib>
#include <cstring>
#include <fstream>
#include <string>
#include <vector>

namespace {

Evas_Object* contentGet(void* data, Evas_Object* grid, const char* part) {
  if (strcmp(part, "elm.swallow.icon") != 0) return nullptr;
  Evas_Object* picture = elm_image_add(grid);
  elm_image_file_set(picture, static_cast<const std::string*>(data)->c_str(), nullptr);
  elm_image_aspect_fixed_set(picture, EINA_TRUE);
  elm_image_fill_outside_set(picture, EINA_TRUE);
  evas_object_show(picture);
  return picture;
}

Evas_Object* createGrid(Evas_Object* window, size_t count, const std::vector<std::string>& paths) {
  static Elm_Gengrid_Item_Class* itemClass = elm_gengrid_item_class_new();
  itemClass->item_style = "default";
  itemClass->func.content_get = contentGet;

  Evas_Object* grid = elm_gengrid_add(window);
  evas_object_size_hint_weight_set(grid, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
  elm_gengrid_align_set(grid, 0.0, 0.0);
  elm_scroller_policy_set(grid, ELM_SCROLLER_POLICY_OFF, ELM_SCROLLER_POLICY_AUTO);
  elm_gengrid_item_size_set(grid, 180, 180);
  for (size_t i = 0; i < count; ++i) {
    elm_gengrid_item_append(grid, itemClass, &paths[i % paths.size()], nullptr, nullptr);
  }
  elm_win_resize_object_add(window, grid);
  evas_object_show(grid);
  return grid;
}

}  // namespace

EAPI_MAIN int elm_main(int argc, char** argv) {
  if (argc != 3) return 2;
  static std::vector<std::string> paths;
  std::ifstream list(argv[2]);
  for (std::string path; std::getline(list, path);) paths.push_back(path);
  if (paths.empty()) return 1;
  elm_policy_set(ELM_POLICY_QUIT, ELM_POLICY_QUIT_LAST_WINDOW_CLOSED);
  Evas_Object* window = elm_win_util_standard_add("bare-grid", "bare-grid");
  elm_win_autodel_set(window, EINA_TRUE);
  createGrid(window, strtoul(argv[1], nullptr, 10), paths);
  evas_object_resize(window, 720, 1280);
  evas_object_show(window);
  elm_run();
  return 0;
}
ELM_MAIN()
