import java.io.File
import org.voreleffect.Glyph
import org.voreleffect.Look
import org.voreleffect.PictureView
import org.voreleffect.Stops

/** A letter in a look, painted on a grey page: TitleKt FILE writes the page's pixels, R, G, B, A. */
fun main(arguments: Array<String>) {
    val letter = ByteArray(60 * 72) { i -> // an H
        val x = i % 60
        val y = i / 60
        (if (x < 18 || x >= 42 || y in 27..44) 255 else 0).toByte()
    }

    val look = Look()
        .fill(0xE8412C)
        .outerShadow(135f, 6f, 8f, 0x1B2A41, 0.6f)
        .stroke(4f, 0xFFFFFF)
        .linearGradient(270f, 1f, 1f, Stops.builder().add(0xFFD75E, 0f).add(0xFFD75E, 0f, 1f).build())

    val page = ByteArray(4 * 100 * 110) { i -> (if (i % 4 == 3) 255 else 200).toByte() }
    look.paint(Glyph(0, 0, letter, 60, 72), PictureView.of(page, 100, 110), 20, 18)
    File(arguments[0]).writeBytes(page)
}
