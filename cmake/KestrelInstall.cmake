file(GLOB x *.none)
