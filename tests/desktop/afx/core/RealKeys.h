#pragma once

/// @file
/// Keys pressed as on the display's own keyboard: by place, whatever the layout.

#include <cstdlib>
#include <dlfcn.h>
#include <initializer_list>
#include <string>

/// The display's keyboard. Keys are numbered by the display's key codes.
class RealKeys {
public:
    static constexpr unsigned control = 37;
    static constexpr unsigned shift = 50;
    static constexpr unsigned alt = 64;
    static constexpr unsigned altGr = 108;

    RealKeys() : m_display(call<void*(const char*)>("libX11.so.6", "XOpenDisplay")(nullptr)) {}
    ~RealKeys() {
        layout("us");
        call<int(void*)>("libX11.so.6", "XCloseDisplay")(m_display);
    }
    RealKeys(const RealKeys&) = delete;
    RealKeys& operator=(const RealKeys&) = delete;

    /// Gives the keyboard layouts ("us,ru"), of which the first is used.
    bool layout(const std::string& names) {
        return std::system(("setxkbmap -layout " + names).c_str()) == 0;
    }
    /// Switches to one of the layouts, from 0.
    void group(unsigned number) {
        constexpr unsigned coreKeyboard = 0x100;
        call<int(void*, unsigned, unsigned)>("libX11.so.6", "XkbLockGroup")(m_display, coreKeyboard, number);
        flush();
    }
    void press(unsigned key, bool down) {
        call<int(void*, unsigned, int, unsigned long)>("libXtst.so.6", "XTestFakeKeyEvent")(m_display, key, down, 0);
        flush();
    }
    /// Presses the keys in their order and releases them from the last to the first.
    void chord(std::initializer_list<unsigned> keys) {
        for (const unsigned key : keys) {
            press(key, true);
        }
        for (const unsigned* key = keys.end(); key != keys.begin();) {
            press(*--key, false);
        }
    }

private:
    template <typename Call>
    static Call* call(const char* library, const char* name) {
        return reinterpret_cast<Call*>(dlsym(dlopen(library, RTLD_NOW), name));
    }
    void flush() {
        call<int(void*, int)>("libX11.so.6", "XSync")(m_display, 0);
    }
    void* m_display;
};
