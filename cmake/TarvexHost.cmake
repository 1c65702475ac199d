# What a host application uses to build itself from its sources and its resource script.
