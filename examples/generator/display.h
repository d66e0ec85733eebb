// The example's display: every kind of fixture, placed on the painted house. Figures come from scene.h.
#pragma once

#include "display_builder.h"

// Fills an empty document with the whole display, in the form that the editor saves.
void buildDisplay(ZephSimulation& display);

// Its parts.
void hangHouseLights(ZephSimulation& display, AddressBook& addresses);
void hangRoofLights(ZephSimulation& display, AddressBook& addresses);
void hangTreeLights(ZephSimulation& display, AddressBook& addresses);
void hangGardenLights(ZephSimulation& display, AddressBook& addresses);
void hangPixels(ZephSimulation& display);
