# Sources of this area, added to the plug-in's objects.
