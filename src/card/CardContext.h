#pragma once

namespace zorbin {

class CatalogControl;
class FileChooser;
class SettingsBinder;

// What the tabs of the settings page share with the card that holds them. Everything belongs
// to the card and outlives the tabs.
struct CardContext
{
    CatalogControl &control;
    SettingsBinder &binder;
    FileChooser *files; // never null; the platform's dialogs unless a test answers them
};

} // namespace zorbin
