# Marks plain comments for Doxygen, and leaves out the one class that it can't place.
/^template <>$/{
  N
  /struct std::hash/{
    :rest
    N
    /\n};$/!b rest
    d
  }
}
s|^( *)// ?|\1/// |
