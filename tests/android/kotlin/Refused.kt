import org.voreleffect.Glyph
import org.voreleffect.Look

/** To be refused by the compiler: the name of the annotation tells it that null is not taken. */
fun paintNothing(look: Look): Int = look.paint(null as Glyph?).width()
