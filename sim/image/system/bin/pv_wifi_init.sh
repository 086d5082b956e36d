A handset tool: the platform runs the build's own program of this name, never this file.
