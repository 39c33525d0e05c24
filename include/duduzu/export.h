// Symbol export for libduduzu: everything not marked DUDUZU_API stays internal.
#pragma once

#define DUDUZU_API __attribute__((visibility("default")))
