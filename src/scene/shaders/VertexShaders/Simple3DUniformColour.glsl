// One colour, in world space.
uniform mat4 u_ViewProjection;
uniform vec4 u_ModelColour;

attribute vec3 a_position;

varying vec4 v_Colour;

void main()
{
	v_Colour = u_ModelColour;
	gl_Position = u_ViewProjection * vec4(a_position, 1.0);
}
