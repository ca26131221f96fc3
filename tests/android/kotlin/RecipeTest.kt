import android.graphics.Bitmap
import android.graphics.Paint
import org.voreleffect.Look

/** The recipe of docs/java.md, run with stand-ins for Android's classes. */
fun main() {
    val page = Bitmap.createBitmap(200, 150, Bitmap.Config.ARGB_8888)
    val touched = sale(page)!!
    check(touched.left < 40 && touched.top < 110 && touched.right > 60 && touched.bottom > 120) { touched }
    check(page.memory[(115 * 200 + 50) * 4 + 3] == 255.toByte()) { "nothing was painted" }
    check(page.locks == 1 && page.unlocks == 1) { "locks" }

    val paint = Paint(0)
    val titles = Titles(paint, Look().fill(0x3366CC).stroke(2f, 0xFFFFFF))
    val first = Bitmap.createBitmap(60, 40, Bitmap.Config.ARGB_8888)
    val second = Bitmap.createBitmap(60, 40, Bitmap.Config.ARGB_8888)
    titles.draw("Title", first, 10, 20)
    titles.draw("Title", second, 10, 20)
    titles.draw("", second, 10, 20)
    check(first.memory == second.memory) { "the cached title differs" }
    check(first.memory[(15 * 60 + 20) * 4 + 2] == 0xCC.toByte()) { "no fill" }
    println("the recipe paints")
}
